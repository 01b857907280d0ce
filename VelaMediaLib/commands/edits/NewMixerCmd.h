#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>
#include <VelaMediaLib/model/timeline/GenericMixer.h>

#include <string>

namespace VelaMediaLib {

/// Adds a new, empty mixer under a name to the timeline of the handler's
/// project. The mixer is made on the first run; undo takes it off the
/// timeline and redo puts the same mixer back. A name the timeline already
/// has throws AddRemoveException, changing nothing; a handler of no project
/// throws VelaMediaLibException "the command needs a project".
class VELAMEDIALIB_API NewMixerCmd : public Command {
public:
    /// Throws ValueException<int> "a mixer needs a name" for an empty name.
    static boost::shared_ptr<NewMixerCmd> create(const std::string& name);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    /// The mixer made, once the command has run.
    const boost::shared_ptr<GenericMixer>& mixer() const { return mixer_; }

private:
    explicit NewMixerCmd(const std::string& name) : mixerName_(name) {}

    std::string mixerName_;
    boost::shared_ptr<GenericMixer> mixer_;
};

} // namespace VelaMediaLib
