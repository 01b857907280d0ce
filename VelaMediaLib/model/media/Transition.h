#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/base/XMLIdentified.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

#include <boost/shared_ptr.hpp>
#include <boost/weak_ptr.hpp>
#include <string>
#include <utility>

namespace VelaMediaLib {

class Media;

/// A transition at a clip's edge, or between two touching clips: its kind by
/// name, its length in ticks and the clips on either side.
class VELAMEDIALIB_API Transition : public VelaObject, public virtual XMLIdentified {
public:
    Transition(std::string name, VelaTime duration) : name_(std::move(name)), duration_(duration) {}

    const std::string& name() const { return name_; }
    VelaTime duration() const { return duration_; }
    void setDuration(VelaTime duration) { duration_ = duration; }
    boost::shared_ptr<Media> leftMedia() const { return leftMedia_.lock(); }
    boost::shared_ptr<Media> rightMedia() const { return rightMedia_.lock(); }
    void setLeftMedia(const boost::weak_ptr<Media>& media) { leftMedia_ = media; }
    void setRightMedia(const boost::weak_ptr<Media>& media) { rightMedia_ = media; }

    /// Joins the transition that two touching clips share again: when the
    /// earlier clip has a right transition (or else the later one a left one),
    /// both clips take it. A pair that does not touch is left alone.
    static void
    mergeMediaPairTransitions(const std::pair<boost::shared_ptr<Media>, boost::shared_ptr<Media>>& pair);

    boost::shared_ptr<Transition> clone() const {
        return boost::shared_ptr<Transition>(new Transition(name_, duration_));
    }

private:
    std::string name_;
    VelaTime duration_;
    boost::weak_ptr<Media> leftMedia_;
    boost::weak_ptr<Media> rightMedia_;
};

typedef boost::shared_ptr<Transition> TransitionPtr;

} // namespace VelaMediaLib
