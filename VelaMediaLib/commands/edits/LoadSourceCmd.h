#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>

#include <string>

namespace VelaMediaLib {

class Source;

/// Puts a source in the project's source bin. Undo takes the same source
/// object out again and redo puts it back where it was, so clips and
/// commands that refer to it stay valid; the file is read once. A file the
/// bin holds already is not loaded twice: the command then takes no effect.
class VELAMEDIALIB_API LoadSourceCmd : public Command {
public:
    /// Loads a source made already, at the end of the bin.
    static boost::shared_ptr<LoadSourceCmd> create(const boost::shared_ptr<Source>& source);
    /// Reads the file when executed and inserts its source at the index (-1 appends).
    static boost::shared_ptr<LoadSourceCmd> create(const std::string& path, int index = -1);

    /// Throws VelaMediaLibException "loading a source needs a project" for a
    /// handler of no project, and what the bin throws (see SourceBin).
    bool execute(CommandHandler* handler) override;
    /// Throws as Project::unloadSource does while the timeline plays the source.
    bool unexecute(CommandHandler* handler) override;
    bool reexecute(CommandHandler* handler) override;

    /// The source loaded; null before a load from a path was executed.
    boost::shared_ptr<Source> source() const { return source_; }

private:
    LoadSourceCmd(const boost::shared_ptr<Source>& source, const std::string& path, int index)
        : source_(source), path_(path), index_(index) {}

    boost::shared_ptr<Source> source_;
    std::string path_;
    int index_;
};

} // namespace VelaMediaLib
