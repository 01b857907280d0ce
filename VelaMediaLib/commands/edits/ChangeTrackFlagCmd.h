#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>
#include <VelaMediaLib/model/timeline/Track.h>

namespace VelaMediaLib {

/// Sets one of a track's flags (locked, hidden or solo) and puts back what
/// it had on undo: for the locked flag, kept as metadata, that is the entry's
/// text, or no entry at all when there was none.
class VELAMEDIALIB_API ChangeTrackFlagCmd : public Command {
public:
    enum Flag { Locked, Hidden, Solo };

    static boost::shared_ptr<ChangeTrackFlagCmd> create(const TrackPtr& track, Flag flag, bool value);

    bool execute(CommandHandler*) override;
    bool unexecute(CommandHandler*) override;

private:
    ChangeTrackFlagCmd(const TrackPtr& track, Flag flag, bool value)
        : track_(track), flag_(flag), value_(value) {}
    bool current() const;
    void set(bool value);

    TrackPtr track_;
    Flag flag_;
    bool value_;
    bool previous_ = false;
    bool hadLockEntry_ = false;
    std::string previousLockText_;
};

} // namespace VelaMediaLib
