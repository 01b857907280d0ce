#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/base/XMLIdentified.h>
#include <VelaMediaLib/document/format/JSONTree.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

#include <boost/shared_ptr.hpp>
#include <boost/weak_ptr.hpp>
#include <string>
#include <utility>

namespace VelaMediaLib {

class Media;
class SubTimeline;
class XMLOptions;

/// A transition at a clip's edge, or between two touching clips: its kind by
/// name, its length in ticks, the clips on either side and its attributes
/// (the transition kind's parameters, kept whole as the document gave them).
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
    const JSONTree& attributes() const { return attributes_; }
    void setAttributes(const JSONTree& attributes) { attributes_ = attributes; }

    /// The transition's object, closed at indent: "name", "duration",
    /// "leftMedia" and "rightMedia" (the ids the clips have in this write;
    /// a side without a clip is left out), "attributes" (when not empty).
    /// Written in a track's list (`owner`), only the sides whose clips lie on
    /// that track are named: a transition whose clips were pulled onto two
    /// tracks is written as each track's one-sided transition, once each.
    void toJSON(XMLOptions& options, int indent, const SubTimeline* owner = nullptr) const;

    /// Joins the transition that two touching clips share again: when the
    /// earlier clip has a right transition (or else the later one a left one),
    /// both clips take it, and a clip that held it on that side elsewhere lets
    /// go. A pair that does not touch is left alone, and so is one where either
    /// clip would be left shorter than its transitions together.
    static void
    mergeMediaPairTransitions(const std::pair<boost::shared_ptr<Media>, boost::shared_ptr<Media>>& pair);

    /// Whether the clip, holding the transition `in` in the place of `out`
    /// (either may be null), is still as long as its transitions together.
    /// Every edit that puts a transition on a clip asks this; a trim may
    /// later take one tick more (the temporal editor's minimum).
    static bool roomFor(const Media& clip, const boost::shared_ptr<Transition>& in,
                        const boost::shared_ptr<Transition>& out);
    /// The shortest track duration transitions of these lengths allow: both
    /// together less one tick, never negative. Trims, stretches and states
    /// set on a clip keep at least this.
    static VelaTime minimumTrackDuration(VelaTime left, VelaTime right) {
        return left + right - 1 > 0 ? left + right - 1 : 0;
    }
    /// The same for the clip's own transitions.
    static VelaTime minimumTrackDuration(const Media& clip);
    /// Whether a clip of this duration keeps the room its transitions need.
    static bool keepsRoom(const Media& clip, VelaTime duration) {
        return duration >= minimumTrackDuration(clip);
    }
    /// A transition's length, 0 for none.
    static VelaTime lengthOf(const boost::shared_ptr<Transition>& transition) {
        return transition ? transition->duration() : 0;
    }

    boost::shared_ptr<Transition> clone() const {
        const boost::shared_ptr<Transition> copy(new Transition(name_, duration_));
        copy->attributes_ = attributes_;
        return copy;
    }

private:
    std::string name_;
    VelaTime duration_;
    boost::weak_ptr<Media> leftMedia_;
    boost::weak_ptr<Media> rightMedia_;
    JSONTree attributes_;
};

typedef boost::shared_ptr<Transition> TransitionPtr;
/// The name the document's writers and readers know transitions by.
typedef Transition GenericTransition;

} // namespace VelaMediaLib
