#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/JSONReader.h>

namespace VelaMediaLib {

class FileSystem;
class MediaFileStats;

/// Reads the "sourceBin" array: each entry becomes a source built from its
/// recorded stats ("src", "rect", "sourceTracks"), never by reading the
/// file, registered under its "id" and put in the bin in order. Then the
/// file is looked at through the file system: a file that cannot be reached
/// goes to the MissingFileHandler (the source loads offline), one whose
/// present stats differ from the recorded ones to the ChangedFileHandler
/// (the source keeps the recorded stats). A handler answering false stops
/// the load: ParserException "Load cancelled: " and the path.
class VELAMEDIALIB_API SourceBinReader : public JSONReader {
public:
    SourceBinReader(const boost::shared_ptr<ReadContext>& context,
                    const boost::shared_ptr<FileSystem>& fileSystem);
    bool read(const Json::Value& sources) override;

    /// The stats an entry records.
    static boost::shared_ptr<MediaFileStats> readStats(const Json::Value& entry);

private:
    void readSource(const Json::Value& entry);
    void checkFile(Source& source, const MediaFileStats& recorded) const;

    boost::shared_ptr<FileSystem> fileSystem_;
};

} // namespace VelaMediaLib
