#pragma once
// The two shapes of the animation and keyframe commands: edits of a clip's
// animation tracks, and edits of keyframed parameters. Both keep what they
// changed as it was before and after, so undo and redo give back exact states
// whatever the edit did, and both refuse (false) an edit that changed nothing.

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>
#include <VelaMediaLib/model/media/MediaImpl.h>

#include <map>
#include <string>
#include <vector>

namespace VelaMediaLib {

/// An edit of one clip's animation tracks. The edit works on a copy of the
/// animations by parameter name; the tracks it changed must then hold
/// animations of at least one tick each that do not overlap (kept in start
/// order), or the command is refused. Undo and redo set every track back to
/// what it was. An animation is named by its parameter and its start tick.
/// Animations the commands make or reshape end at their range's end
/// ("endTime") and lead in over at most their length ("duration").
class VELAMEDIALIB_API AnimationTracksEditCmd : public Command {
public:
    typedef AnimationTrack::Animation Animation;
    typedef std::vector<Animation> Animations;
    typedef std::map<std::string, Animations> AnimationLists;

    const MediaPtr& media() const { return media_; }
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    bool reexecute(CommandHandler* handler) override;

    /// The clip's animations by parameter name.
    static AnimationLists animationsOf(const MediaPtr& media);
    /// Throws VelaMediaLibException for a code no interpolater of doubles has
    /// (the empty code, an automatic curve, is allowed).
    static void checkInterpolaterCode(const std::string& code);

protected:
    /// Throws VelaMediaLibException for a null clip or one without animation tracks.
    explicit AnimationTracksEditCmd(const MediaPtr& media);
    /// Edits the lists; false when the clip's animations refuse the edit.
    virtual bool edit(AnimationLists& lists) const = 0;

    /// The animation of the parameter starting at the tick, or null.
    static Animation* find(AnimationLists& lists, const std::string& name, VelaTime start);
    /// Throws VelaMediaLibException when the clip has no parameter of the name.
    static void checkParameter(const MediaPtr& media, const std::string& name);
    /// Throws ValueException<long long> for a length below one tick.
    static void checkLength(VelaTime length);
    /// The range, with "endTime" at its end and the lead-in cut to its length.
    static void reshape(Animation& animation, VelaTime start, VelaTime length);

    MediaPtr media_;

private:
    void apply(const AnimationLists& lists) const;
    static bool holds(Animations& animations);

    AnimationLists before_, after_;
};

/// An edit of keyframed parameters. Each parameter is recorded before the
/// edit changes it (`track`); a parameter the edit had to make on its clip is
/// forgotten again on undo, so the clip writes what it wrote before. A
/// refusal (false, or a KeyFrameException of the parameter) puts every
/// recorded parameter back; any other exception does too and goes on.
/// Undo and redo give each parameter its recorded curve; keyframe objects
/// handed out before are then no longer the parameter's.
class VELAMEDIALIB_API ParameterCurvesEditCmd : public Command {
public:
    typedef boost::shared_ptr<ParameterInterface> ParameterPtr;

    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    bool reexecute(CommandHandler* handler) override;

protected:
    /// Makes the change, recording each parameter before changing it; false
    /// when the parameter's present curve refuses.
    virtual bool edit() = 0;
    void track(const ParameterPtr& parameter);
    /// The clip's parameter of the name, made if need be, recorded.
    ParameterPtr track(const MediaPtr& media, const std::string& name);

private:
    struct Curve {
        MediaPtr owner; // set when the edit made the parameter on it
        std::string name;
        ParameterPtr parameter, before, after;
    };
    void rollBack();
    static void give(const ParameterPtr& parameter, const ParameterPtr& saved);

    std::vector<Curve> curves_;
};

/// Calls `visit(Parameter<T>&)` for the parameter's value type T; false for a
/// parameter of no known value type.
template <typename Visit>
bool visitTypedParameter(ParameterInterface& parameter, Visit visit) {
#define VELA_VISIT_TYPED(Type)                                                                               \
    if (auto* typed = dynamic_cast<Parameter<Type>*>(&parameter)) {                                          \
        visit(*typed);                                                                                       \
        return true;                                                                                         \
    }
    VELA_FOR_EACH_PARAMETER_VALUE_TYPE(VELA_VISIT_TYPED)
#undef VELA_VISIT_TYPED
    return false;
}

} // namespace VelaMediaLib
