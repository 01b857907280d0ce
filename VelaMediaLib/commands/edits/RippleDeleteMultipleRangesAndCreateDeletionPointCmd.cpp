#include <VelaMediaLib/commands/edits/RippleDeleteMultipleRangesAndCreateDeletionPointCmd.h>

#include <algorithm>

namespace VelaMediaLib {

boost::shared_ptr<RippleDeleteMultipleRangesAndCreateDeletionPointCmd>
RippleDeleteMultipleRangesAndCreateDeletionPointCmd::create(std::vector<Range<VelaTime>> ranges) {
    if (ranges.empty()) throw VelaMediaLibException("no range to ripple delete");
    std::sort(ranges.begin(), ranges.end(),
              [](const Range<VelaTime>& a, const Range<VelaTime>& b) { return a.start() > b.start(); });
    for (size_t i = 0; i < ranges.size(); ++i) {
        if (ranges[i].duration() <= 0)
            throw VelaMediaLibException("a deleted range must be longer than zero");
        if (i > 0 && ranges[i].end() >= ranges[i - 1].start())
            throw VelaMediaLibException("deleted ranges must neither overlap nor touch");
    }
    const boost::shared_ptr<RippleDeleteMultipleRangesAndCreateDeletionPointCmd> command(
        new RippleDeleteMultipleRangesAndCreateDeletionPointCmd(ranges));
    command->setName("Ripple Delete Ranges");
    return command;
}

} // namespace VelaMediaLib
