#include <VelaMediaLib/commands/edits/AddParameterKeyFrameInterfaceCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<AddParameterKeyFrameInterfaceCmd>
AddParameterKeyFrameInterfaceCmd::create(const ParameterPtr& parameter,
                                         const boost::shared_ptr<KeyFrameInterface>& keyframe) {
    if (!parameter || !keyframe) throw VelaMediaLibException("no parameter or keyframe to add");
    bool sameType = false;
    visitTypedParameter(*parameter, [&](auto& typed) {
        typedef typename std::decay_t<decltype(typed)>::ValueType T;
        sameType = dynamic_cast<const KeyFrame<T>*>(keyframe.get()) != nullptr;
    });
    if (!sameType)
        throw TypeException("a keyframe of another value type than parameter " + parameter->identifier());
    boost::shared_ptr<AddParameterKeyFrameInterfaceCmd> command(
        new AddParameterKeyFrameInterfaceCmd(parameter, keyframe->cloneKeyFrame()));
    command->setName("Add Keyframe");
    return command;
}

// Each run adds a fresh copy joined to the parameter's project.
bool AddParameterKeyFrameInterfaceCmd::edit() {
    track(parameter_);
    visitTypedParameter(*parameter_, [&](auto& typed) {
        typedef typename std::decay_t<decltype(typed)>::ValueType T;
        const auto copy = boost::static_pointer_cast<KeyFrame<T>>(keyframe_)->clone();
        copy->setMetaDataProjectMutex(typed.projectMutex());
        typed.addKeyFrame(copy);
    });
    return true;
}

} // namespace VelaMediaLib
