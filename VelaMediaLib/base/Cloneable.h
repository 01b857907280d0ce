#pragma once

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

/// Something that can be copied whole.
class Cloneable {
public:
    virtual ~Cloneable() = default;
};

/// A Cloneable whose copies are of a known base type.
template <typename Base>
class DecoratedCloneable : public Cloneable {
public:
    virtual boost::shared_ptr<Base> clone() const = 0;
};

} // namespace VelaMediaLib
