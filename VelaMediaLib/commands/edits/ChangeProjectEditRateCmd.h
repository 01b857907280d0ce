#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>

#include <boost/rational.hpp>

namespace VelaMediaLib {

/// Sets the edit rate of the handler's project and nothing else: its sources
/// and their clips' limits follow (Project::setEditRate), ticks keep their
/// count. Undo sets the rate it had. A rate of 0 throws VelaMediaLibException
/// "an edit rate must be greater than 0"; the rate the project has already
/// reports false. A handler of no project throws "the command needs a project".
class VELAMEDIALIB_API SetEditRateCmd : public Command {
public:
    static boost::shared_ptr<SetEditRateCmd> create(const boost::rational<unsigned long>& rate);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;

private:
    explicit SetEditRateCmd(const boost::rational<unsigned long>& rate) : rate_(rate) {}

    boost::rational<unsigned long> rate_, saved_;
};

/// Changes the project's edit rate keeping every time where it was in
/// seconds: each mixer of the timeline and each clipping of the clipboard
/// is carried over (ScaleMixerEditRateCmd), the timeline's keyframes (markers,
/// camera) are scaled exactly, then the rate is set (SetEditRateCmd). Ticks go
/// to the nearest tick of the new rate, so a change to a finer rate and back
/// gives back the same document. Undo gives back every saved state. The
/// project's own rate reports false; a rate of 0 throws as SetEditRateCmd.
class VELAMEDIALIB_API ChangeProjectEditRateCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException "an edit rate must be greater than 0".
    static boost::shared_ptr<ChangeProjectEditRateCmd> create(const boost::rational<unsigned long>& rate);
    static boost::shared_ptr<ChangeProjectEditRateCmd> create(unsigned long numerator,
                                                              unsigned long denominator = 1);
    using MultiCommand::execute;
    bool execute(CommandHandler* handler) override;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit ChangeProjectEditRateCmd(const boost::rational<unsigned long>& rate) : rate_(rate) {}

    boost::rational<unsigned long> rate_;
};

} // namespace VelaMediaLib
