#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Mixer.h>

#include <string>
#include <vector>

namespace VelaMediaLib {

class Project;

/// Copies what a tick range of some tracks holds into a clipping: a mixer of
/// one track per given track (in the order given) holding copies of the clips
/// that meet the range, cut at its edges (a clip reaching in from before
/// starts at the range's start and plays on from there, its keyframes,
/// animations and effects cut as a split cuts them) and counted from the
/// range's start. A transition comes along where its edge lies inside the
/// range (or on its edge) and every clip it joins on the track comes too; a
/// cut clip too short for its transitions leaves them behind. The clipping's
/// document (clippingToJSONString) is the clipboard's text, which a
/// PasteClippingCmd reads into this or another project of the same rate.
///
/// A copy changes nothing, so it is no undo step: execute does the copy and
/// returns false, and the history records nothing; clippingText() then holds
/// the document. Hosts that do not need a command call clippingDocument.
/// create throws VelaMediaLibException for no tracks, a null track or a
/// range of no ticks; execute throws it for tracks of another project than
/// the handler's.
class VELAMEDIALIB_API CopyRangeClippingCmd : public Command {
public:
    static boost::shared_ptr<CopyRangeClippingCmd> create(const std::vector<TrackPtr>& tracks,
                                                          const Range<VelaTime>& range);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler*) override { return true; }
    /// The document of the last execution; empty before it.
    const std::string& clippingText() const { return text_; }
    /// The clipping of the last execution (its clips on no timeline).
    const MixerPtr& clipping() const { return clipping_; }

    /// The clipping of the tracks' range, as described above.
    static MixerPtr clippingOf(const std::vector<TrackPtr>& tracks, const Range<VelaTime>& range);
    /// Its document, the project giving the edit rate. Throws as execute.
    static std::string clippingDocument(const Project& project, const std::vector<TrackPtr>& tracks,
                                        const Range<VelaTime>& range);
    /// Throws VelaMediaLibException unless there are tracks, none null, and the range has ticks.
    static void checkArguments(const std::vector<TrackPtr>& tracks, const Range<VelaTime>& range);
    /// Throws VelaMediaLibException "the tracks are not of the project edited"
    /// unless every track belongs to the project.
    static void checkTracksOf(const Project& project, const std::vector<TrackPtr>& tracks);

private:
    CopyRangeClippingCmd(const std::vector<TrackPtr>& tracks, const Range<VelaTime>& range)
        : tracks_(tracks), range_(range) {}
    std::vector<TrackPtr> tracks_;
    Range<VelaTime> range_;
    std::string text_;
    MixerPtr clipping_;
};

/// Copies a range as CopyRangeClippingCmd does, then takes the range's
/// content off the tracks: a clip across an edge of the range is split there
/// (SplitCmd) and every clip inside is removed (RemoveMediaCmd). Undo puts
/// everything back as it was; clippingText() keeps the document. A range
/// holding nothing is no step (false, nothing changed, an empty clipping's
/// text). On a magnetic track the gap closes as a step of its own.
class VELAMEDIALIB_API CutRangeClippingCmd : public MultiCommand {
public:
    /// Throws as CopyRangeClippingCmd::create.
    static boost::shared_ptr<CutRangeClippingCmd> create(const std::vector<TrackPtr>& tracks,
                                                         const Range<VelaTime>& range);
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;
    const std::string& clippingText() const { return text_; }

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    CutRangeClippingCmd(const std::vector<TrackPtr>& tracks, const Range<VelaTime>& range)
        : tracks_(tracks), range_(range) {}
    /// Splits the track at the tick where a clip crosses it; false when refused.
    bool splitAt(const TrackPtr& track, VelaTime time);
    std::vector<TrackPtr> tracks_;
    Range<VelaTime> range_;
    std::string text_;
};

} // namespace VelaMediaLib
