#include <VelaMediaLib/commands/edits/GroupCmd.h>

#include <VelaMediaLib/commands/edits/CreateGroupCmd.h>
#include <VelaMediaLib/commands/edits/ResizeGroupCmd.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

namespace VelaMediaLib {
namespace {

// The canvas of what the group stands in: the group holding its track's
// mixer when that has a size, else the timeline.
std::pair<int, int> canvasAround(const Group& group) {
    const TrackPtr track = boost::dynamic_pointer_cast<Track>(group.parent());
    const MixerPtr mixer = track ? track->parentMixer() : MixerPtr();
    if (!mixer) return std::make_pair(0, 0);
    const GroupPtr outer = boost::dynamic_pointer_cast<Group>(mixer->parentGroup());
    if (outer && outer->width() > 0 && outer->height() > 0)
        return std::make_pair(outer->width(), outer->height());
    const TimelinePtr timeline = mixer->enclosingTimeline();
    if (!timeline) return std::make_pair(0, 0);
    return std::make_pair(timeline->attributeValue<int>("width", 0),
                          timeline->attributeValue<int>("height", 0));
}

} // namespace

boost::shared_ptr<GroupCmd> GroupCmd::create(const std::vector<MediaPtr>& clips) {
    CreateGroupCmd::create(clips); // the selection's refusals, before anything is recorded
    const boost::shared_ptr<GroupCmd> command(new GroupCmd(clips));
    command->setName("Group");
    return command;
}

void GroupCmd::executeCommands(const CommandHandler*) {
    const boost::shared_ptr<CreateGroupCmd> creation = CreateGroupCmd::create(clips_);
    if (!executeRequired(creation)) return;
    group_ = creation->createdGroup();
    const std::pair<int, int> canvas = canvasAround(*group_);
    if (canvas.first > 0 && canvas.second > 0)
        execute(ResizeGroupCmd::create(group_, canvas.first, canvas.second)); // false when it has the size
}

} // namespace VelaMediaLib
