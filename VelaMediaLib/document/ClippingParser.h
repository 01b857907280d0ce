#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/ParserInterface.h>

#include <boost/shared_ptr.hpp>
#include <istream>
#include <vector>

namespace VelaMediaLib {

class Mixer;
class Project;
class Source;

/// Reads a clipboard document into a project's clipboard. The document is a
/// root object with "version", "editRate" (the rate its ticks count; it must
/// be the project's), "sourceBin" (source entries as in a project) and
/// "clippings", an array of objects each holding "tracks" (track objects);
/// a root "tracks" is one clipping. Sources the project's bin holds (by
/// file) are used; others are added to the bin. Each clipping becomes a
/// mixer added to the clipboard. All or nothing: a failure throws
/// ParserException and leaves the project as it was.
class VELAMEDIALIB_API ClippingParser : public ParserInterface {
public:
    explicit ClippingParser(const boost::shared_ptr<Project>& project);
    bool parse(std::istream& in);
    /// Reads the document as parse does but leaves the project alone: the
    /// clippings go on no clipboard and the sources the bin lacks (one per
    /// file, newSources) into no bin; placing them is the caller's (a paste
    /// does it with undoable commands). Throws as parse.
    bool read(std::istream& in);
    /// The clippings of the last parse or read.
    const std::vector<boost::shared_ptr<Mixer>>& clippings() const { return clippings_; }
    /// The sources the last read made for files the bin lacked, in document order.
    const std::vector<boost::shared_ptr<Source>>& newSources() const { return newSources_; }
    VersionInfo versionInfo() const override { return versionInfo_; }

private:
    boost::shared_ptr<Project> project_;
    std::vector<boost::shared_ptr<Mixer>> clippings_;
    std::vector<boost::shared_ptr<Source>> newSources_;
    VersionInfo versionInfo_;
};

} // namespace VelaMediaLib
