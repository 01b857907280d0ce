#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <string>
#include <vector>

namespace VelaMediaLib {

/// Pastes a clipping document (as CopyRangeClippingCmd writes it, read with
/// ClippingParser) onto tracks of the handler's project: the clips of the
/// clipping's track i go on the i-th given track, each at the paste time plus
/// its start in the clipping, with the transitions the clipping carries.
/// Sources the clips play that the project's bin lacks (by file) are added
/// first (LoadSourceCmd), then each clip is placed (AddMediaCmd): a paste
/// places and never ripples. Undo takes the clips off and the added sources
/// out again, so the document is as before, byte for byte.
///
/// Refusals change nothing: a text that does not read, or a clipping of
/// another edit rate, throws the parser's ParserException; a document of
/// more than one clipping, a clipping track holding clips beyond the given
/// tracks, or tracks of another project throw VelaMediaLibException; a clip
/// that would collide with one on its track refuses the paste (false).
class VELAMEDIALIB_API PasteClippingCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException for no tracks, a null track or a negative time.
    static boost::shared_ptr<PasteClippingCmd> create(const std::string& clippingText,
                                                      const std::vector<TrackPtr>& tracks, VelaTime time);
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;
    /// The clips the last execution placed, track by track in time order.
    const std::vector<MediaPtr>& pastedMedias() const { return pasted_; }

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    PasteClippingCmd(const std::string& text, const std::vector<TrackPtr>& tracks, VelaTime time)
        : text_(text), tracks_(tracks), time_(time) {}
    std::string text_;
    std::vector<TrackPtr> tracks_;
    VelaTime time_;
    std::vector<MediaPtr> pasted_;
};

/// Copies a range of tracks (CopyRangeClippingCmd) and pastes it at another
/// time (PasteClippingCmd), onto the same tracks or onto others given, as
/// one undo step. Refused as the paste is: a paste colliding with the range
/// itself (or anything else) changes nothing.
class VELAMEDIALIB_API CopyRangeAndPasteCmd : public MultiCommand {
public:
    /// Throws as CopyRangeClippingCmd::create and PasteClippingCmd::create;
    /// no targets means the tracks copied from.
    static boost::shared_ptr<CopyRangeAndPasteCmd> create(const std::vector<TrackPtr>& tracks,
                                                          const Range<VelaTime>& range, VelaTime time,
                                                          const std::vector<TrackPtr>& targets = {});
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;
    const std::vector<MediaPtr>& pastedMedias() const { return pasted_; }

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    CopyRangeAndPasteCmd(const std::vector<TrackPtr>& tracks, const Range<VelaTime>& range, VelaTime time,
                         const std::vector<TrackPtr>& targets)
        : tracks_(tracks), range_(range), time_(time), targets_(targets) {}
    std::vector<TrackPtr> tracks_;
    Range<VelaTime> range_;
    VelaTime time_;
    std::vector<TrackPtr> targets_;
    std::vector<MediaPtr> pasted_;
};

} // namespace VelaMediaLib
