#include <VelaMediaLib/model/media/GroupChildrensTimeConverter.h>

#include <VelaMediaLib/model/media/Group.h>

namespace VelaMediaLib {

boost::shared_ptr<const Media> GroupChildrensTimeConverter::container() const {
    return group_.shared_from_this();
}

} // namespace VelaMediaLib
