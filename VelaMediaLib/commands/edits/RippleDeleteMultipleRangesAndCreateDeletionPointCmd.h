#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/RippleDeleteRangeAndCreateDeletionPointCmd.h>

namespace VelaMediaLib {

/// Ripple-deletes several ranges at once, each as
/// RippleDeleteRangeAndCreateDeletionPointCmd does, from the latest range to
/// the earliest, so the times of the ranges still to go stay valid. Each
/// range leaves a deletion point of its own per track (at the range's start
/// less the lengths of the earlier ranges, where its content now joins), so
/// one can be restored without the others. Restoring them from the earliest
/// on gives the tracks back as they were, cuts joined.
///
/// create throws VelaMediaLibException, for no range, a range not longer
/// than zero, or two ranges that overlap or touch (touching ranges are one
/// range: give it so).
class VELAMEDIALIB_API RippleDeleteMultipleRangesAndCreateDeletionPointCmd
    : public RippleDeleteRangeAndCreateDeletionPointCmd {
public:
    static boost::shared_ptr<RippleDeleteMultipleRangesAndCreateDeletionPointCmd>
    create(std::vector<Range<VelaTime>> ranges);

private:
    explicit RippleDeleteMultipleRangesAndCreateDeletionPointCmd(const std::vector<Range<VelaTime>>& ranges)
        : RippleDeleteRangeAndCreateDeletionPointCmd(ranges) {}
};

} // namespace VelaMediaLib
