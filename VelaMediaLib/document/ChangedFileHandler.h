#pragma once

#include <VelaMediaLib/base/Export.h>

#include <string>

namespace VelaMediaLib {

class MediaFileStats;

/// Asked by the project parser about each file whose present stats differ
/// from those the document recorded. True lets the load go on (the source
/// keeps the recorded stats); false cancels it.
class VELAMEDIALIB_API ChangedFileHandler {
public:
    virtual ~ChangedFileHandler() = default;
    virtual bool handleChangedFile(const std::string& path, const MediaFileStats& recorded,
                                   const MediaFileStats& present) = 0;
};

} // namespace VelaMediaLib
