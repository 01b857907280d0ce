#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/shared_ptr.hpp>
#include <vector>

namespace VelaMediaLib {

class Media;
class Source;

/// Something that plays an imported source; clips without one answer null.
class VELAMEDIALIB_API Sourceable {
public:
    virtual ~Sourceable() = default;
    virtual boost::shared_ptr<const Source> source() const = 0;
    virtual void setSource(const boost::shared_ptr<const Source>& source) = 0;
    /// Throws when the clip could not play the source; by default any passes.
    virtual void checkSource(const boost::shared_ptr<const Source>&) const {}

    /// The sources the clips play, each once, in the order first met.
    static std::vector<boost::shared_ptr<const Source>>
    sourcesOf(const std::vector<boost::shared_ptr<Media>>& clips);
    /// The clips that play the source.
    static std::vector<boost::shared_ptr<Media>> clipsOf(const std::vector<boost::shared_ptr<Media>>& clips,
                                                         const boost::shared_ptr<const Source>& source);
};

} // namespace VelaMediaLib
