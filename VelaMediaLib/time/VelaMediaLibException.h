#pragma once
// The exception family of the model. Every failure the library reports by
// throwing derives from VelaMediaLibException, which carries its message.

#include <VelaMediaLib/time/Range.h>
#include <VelaMediaLib/time/RationalTime.h>

#include <boost/shared_ptr.hpp>
#include <exception>
#include <string>
#include <typeinfo>

namespace VelaMediaLib {

class Media;

class VelaMediaLibException : public std::exception {
public:
    explicit VelaMediaLibException(std::string message) : message_(std::move(message)) {}
    const char* what() const noexcept override { return message_.c_str(); }
    const std::string& message() const { return message_; }

private:
    std::string message_;
};

/// Carries the value that was refused alongside the message.
template <typename T>
class ValueException : public VelaMediaLibException {
public:
    ValueException(std::string message, T value)
        : VelaMediaLibException(std::move(message)), value_(std::move(value)) {}
    const T& value() const { return value_; }

private:
    T value_;
};

/// A trim that would leave the clip outside its limits: the offset asked for
/// and the clip's track range (start, duration) at the time.
class InvalidTrimRangeException : public ValueException<long long> {
public:
    InvalidTrimRangeException(std::string message, long long offset,
                              Range<long long> trackRange = Range<long long>())
        : ValueException<long long>(std::move(message), offset), trackRange_(trackRange) {}
    const Range<long long>& trackRange() const { return trackRange_; }

private:
    Range<long long> trackRange_;
};

#define VELA_DECLARE_EXCEPTION(Name, Base)                                                                   \
    class Name : public Base {                                                                               \
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

/// A keyframe operation that could not be carried out: the time it was asked
/// for and the identifying text of the parameter.
class KeyFrameException : public VelaMediaLibException {
public:
    explicit KeyFrameException(std::string message, RationalTime time = RationalTime(),
                               std::string identifier = std::string())
        : VelaMediaLibException(std::move(message)), time_(time), identifier_(std::move(identifier)) {}
    const RationalTime& time() const { return time_; }
    const std::string& identifier() const { return identifier_; }

private:
    RationalTime time_;
    std::string identifier_;
};

/// A clip refused by a track because it would overlap another: which range
/// collided, the clip that was being placed and the start asked for.
class CollisionException : public VelaMediaLibException {
public:
    CollisionException(Range<long long> range = Range<long long>(),
                       boost::shared_ptr<Media> clip = boost::shared_ptr<Media>(), long long start = 0)
        : VelaMediaLibException("Collision exception."), range_(range), clip_(std::move(clip)),
          start_(start) {}
    const Range<long long>& range() const { return range_; }
    const boost::shared_ptr<Media>& clip() const { return clip_; }
    long long start() const { return start_; }

private:
    Range<long long> range_;
    boost::shared_ptr<Media> clip_;
    long long start_;
};

/// A weak back-reference (parent, project, source) that had expired when it was needed.
template <typename T>
class DanglingWeakPtrException : public VelaMediaLibException {
public:
    DanglingWeakPtrException()
        : VelaMediaLibException(std::string("dangling weak pointer to ") + typeid(T).name()) {}
    explicit DanglingWeakPtrException(std::string message) : VelaMediaLibException(std::move(message)) {}
};

} // namespace VelaMediaLib
