#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>

namespace VelaMediaLib {

class Source;

/// Takes a source out of the project's source bin; undo puts the same
/// object back where it was. Refused, by the exception of
/// Project::unloadSource, while a clip on the timeline plays the source.
class VELAMEDIALIB_API UnloadSourceCmd : public Command {
public:
    static boost::shared_ptr<UnloadSourceCmd> create(const boost::shared_ptr<Source>& source);

    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;

    /// The source taken out.
    boost::shared_ptr<Source> source() const { return source_; }

private:
    explicit UnloadSourceCmd(const boost::shared_ptr<Source>& source) : source_(source) {}

    boost::shared_ptr<Source> source_;
    int index_ = -1;
};

} // namespace VelaMediaLib
