#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/JSONReader.h>

namespace VelaMediaLib {

class EdgeModification;

/// Reads an array of edge modifications ("duration", "group", "func" with
/// "name" and "value", "parameters") onto one edge of a media. The only
/// function known is "FadeToValueFunc"; another name is refused with
/// ParserException "Unknown edge mod func " and the name.
class VELAMEDIALIB_API EdgeModReader : public JSONReader {
public:
    EdgeModReader(const boost::shared_ptr<ReadContext>& context, Media& media);
    bool read(const Json::Value& modifications) override;

    static boost::shared_ptr<EdgeModification> readEdgeMod(const Json::Value& value);

protected:
    virtual void add(const boost::shared_ptr<EdgeModification>& modification) = 0;
    Media& media() const { return media_; }

private:
    Media& media_;
};

/// The "leftEdgeMods" of a media.
class VELAMEDIALIB_API LeftEdgeModReader : public EdgeModReader {
public:
    using EdgeModReader::EdgeModReader;

protected:
    void add(const boost::shared_ptr<EdgeModification>& modification) override;
};

/// The "rightEdgeMods" of a media.
class VELAMEDIALIB_API RightEdgeModReader : public EdgeModReader {
public:
    using EdgeModReader::EdgeModReader;

protected:
    void add(const boost::shared_ptr<EdgeModification>& modification) override;
};

} // namespace VelaMediaLib
