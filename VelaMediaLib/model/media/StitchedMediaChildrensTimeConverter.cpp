#include <VelaMediaLib/model/media/StitchedMediaChildrensTimeConverter.h>

#include <VelaMediaLib/model/media/StitchedMedia.h>

namespace VelaMediaLib {

boost::shared_ptr<const Media> StitchedMediaChildrensTimeConverter::container() const {
    return stitched_.lock();
}

} // namespace VelaMediaLib
