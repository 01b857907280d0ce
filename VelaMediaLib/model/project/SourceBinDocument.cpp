#include <VelaMediaLib/model/project/SourceBin.h>

#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/model/source/Source.h>

namespace VelaMediaLib {

// The list is copied under the read lock; each source then reads its own
// values under the lock one by one.
void SourceBin::toJSON(XMLOptions& options, int indent) const {
    JSONWriter array(options, indent, JSONWriter::Array);
    for (const boost::shared_ptr<Source>& source : sources()) {
        options.element();
        source->toJSON(options, array.memberLevel());
    }
}

} // namespace VelaMediaLib
