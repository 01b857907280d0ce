#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/source/FileSystem.h>

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

/// The host's own file system. Never throws: a path it cannot ask about
/// neither exists nor is readable.
class VELAMEDIALIB_API BoostFileSystem : public FileSystem {
public:
    bool exists(const std::string& path) const override;
    /// A regular file that can be opened for reading.
    bool isReadable(const std::string& path) const override;

    /// One instance shared by the process.
    static boost::shared_ptr<FileSystem> instance();
};

} // namespace VelaMediaLib
