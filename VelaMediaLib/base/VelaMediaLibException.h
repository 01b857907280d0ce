#pragma once
// The exception family of the model. Every failure the library reports by
// throwing derives from VelaMediaLibException, which carries its message.

#include <VelaMediaLib/base/Export.h>

#include <exception>
#include <string>
#include <typeinfo>

namespace VelaMediaLib {

class VELAMEDIALIB_API VelaMediaLibException : public std::exception {
public:
    explicit VelaMediaLibException(std::string message) : message_(std::move(message)) {}
    const char* what() const noexcept override { return message_.c_str(); }
    const std::string& message() const { return message_; }

private:
    std::string message_;
};

/// Carries the value that was refused alongside the message.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API ValueException : public VelaMediaLibException {
public:
    ValueException(std::string message, T value)
        : VelaMediaLibException(std::move(message)), value_(std::move(value)) {}
    const T& value() const { return value_; }

private:
    T value_;
};

#define VELA_DECLARE_EXCEPTION(Name, Base)                                                                   \
    class VELAMEDIALIB_API Name : public Base {                                                              \
    public:                                                                                                  \
        using Base::Base;                                                                                    \
    }

VELA_DECLARE_EXCEPTION(TypeException, VelaMediaLibException);
VELA_DECLARE_EXCEPTION(IOException, VelaMediaLibException);
VELA_DECLARE_EXCEPTION(IndexException, VelaMediaLibException);
VELA_DECLARE_EXCEPTION(AddRemoveException, VelaMediaLibException);
VELA_DECLARE_EXCEPTION(ParserException, VelaMediaLibException);
VELA_DECLARE_EXCEPTION(ParserVersionException, ParserException);
/// A state from which the model cannot go on (for example an undo that failed half-way).
VELA_DECLARE_EXCEPTION(VelaMediaLibFatalException, VelaMediaLibException);

#undef VELA_DECLARE_EXCEPTION

/// A weak back-reference (parent, project, source) that had expired when it was needed.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API DanglingWeakPtrException : public VelaMediaLibException {
public:
    DanglingWeakPtrException()
        : VelaMediaLibException(std::string("dangling weak pointer to ") + typeid(T).name()) {}
    explicit DanglingWeakPtrException(std::string message) : VelaMediaLibException(std::move(message)) {}
};

} // namespace VelaMediaLib
