#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/AudioMedia.h>
#include <VelaMediaLib/model/media/VisualMedia.h>

#include <cstddef>
#include <iterator>
#include <vector>

namespace VelaMediaLib {

/// Walks a source's clips of one kind (Media, VisualMedia or AudioMedia) in
/// stream order, skipping streams that no clip of the kind plays. The list
/// it walks is fixed when the source is made, and the iterator holds the
/// source alive.
template <typename Kind>
class VELAMEDIALIB_TEMPLATE_API SourceMediaIterator {
public:
    typedef std::forward_iterator_tag iterator_category;
    typedef boost::shared_ptr<Kind> value_type;
    typedef std::ptrdiff_t difference_type;
    typedef const value_type* pointer;
    typedef value_type reference;

    SourceMediaIterator(const boost::shared_ptr<const std::vector<MediaPtr>>& media, size_t index)
        : media_(media), index_(index) {
        skip();
    }

    value_type operator*() const { return boost::dynamic_pointer_cast<Kind>((*media_)[index_]); }
    /// The clip, which the source keeps.
    Kind* operator->() const { return dynamic_cast<Kind*>((*media_)[index_].get()); }
    SourceMediaIterator& operator++() {
        ++index_;
        skip();
        return *this;
    }
    SourceMediaIterator operator++(int) {
        SourceMediaIterator before(*this);
        ++*this;
        return before;
    }
    /// The stream the clip plays.
    int trackIndex() const { return static_cast<int>(index_); }

    bool operator==(const SourceMediaIterator& o) const { return media_ == o.media_ && index_ == o.index_; }
    bool operator!=(const SourceMediaIterator& o) const { return !(*this == o); }

private:
    void skip() {
        while (index_ < media_->size() && !boost::dynamic_pointer_cast<Kind>((*media_)[index_])) ++index_;
    }

    boost::shared_ptr<const std::vector<MediaPtr>> media_;
    size_t index_;
};

} // namespace VelaMediaLib
