// Faults the random-edit soak found in the family commands, each reduced to
// the smallest edit that showed it.
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/ReplaceMediaWithMediasCmd.h>
#include <VelaMediaLib/commands/edits/StitchMediaCmd.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class SoakFindings : public EditTest {};

// A part of a stitched media named on the stitched media's own track: taking
// it off was done, but its undo could not put it back (that track takes no
// clips), so a replacement refused part-way changed the parts for good.
TEST_F(SoakFindings, APartInsideAStitchedMediaIsNotTakenOffItsTrack) {
    const MediaPtr a = place(0, 20), b = place(20, 20);
    const auto stitch = StitchMediaCmd::create(track, {a, b});
    ASSERT_TRUE(project->execute(stitch));
    const TrackPtr inner = stitch->stitchedMedia()->track();
    expectRefusedDocument(RemoveMediaCmd::create(inner, a));
    expectRefusedDocument(ReplaceMediaWithMediasCmd::create(inner, b, {clip(10), clip(5)}));
    EXPECT_EQ(stitch->stitchedMedia()->medias(), (std::vector<MediaPtr>{a, b}));
}

} // namespace
