#include <VelaMediaLib/model/source/BoostFileSystem.h>

#include <boost/filesystem/operations.hpp>
#include <fstream>

namespace VelaMediaLib {

bool BoostFileSystem::exists(const std::string& path) const {
    boost::system::error_code error;
    return boost::filesystem::exists(path, error) && !error;
}

bool BoostFileSystem::isReadable(const std::string& path) const {
    boost::system::error_code error;
    if (!boost::filesystem::is_regular_file(path, error) || error) return false;
    return std::ifstream(path, std::ios::binary).is_open();
}

boost::shared_ptr<FileSystem> BoostFileSystem::instance() {
    static const boost::shared_ptr<FileSystem> shared(new BoostFileSystem);
    return shared;
}

} // namespace VelaMediaLib
