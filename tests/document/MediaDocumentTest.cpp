#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/time/interpolaters/EaseOutInterpolater.h>
#include <VelaMediaLib/time/parameters/ParameterImpl.h>
#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <sstream>

using namespace VelaMediaLib;

namespace {

std::string written(const Media& media, int indent) {
    std::ostringstream out;
    XMLOptions options(out);
    media.toJSON(options, indent);
    return out.str();
}

} // namespace

// A whole clip as a document holds it: attributes of every kind, bare and
// keyframed parameters written member by member in their order, keyframe and
// clip metadata, nested at a deeper level.
TEST(MediaDocument, AClipIsWrittenByteForByte) {
    const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    const boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
    const auto clip = PlaceholderMedia::createFromMediaRange(project, rate, 100, SafeRational(1, 3),
                                                             SafeRational(50), SafeRational(2));
    clip->addAttribute<std::string>("note", "take \"2\"");
    clip->addAttribute<bool>("mixToMono", true);
    clip->addAttribute<double>("gain", 0.75);
    clip->addAttribute<long long>("sourceFileOffset", 9000000000LL);
    clip->addAttribute("color", TemplatedColor<int>(1, 2, 3, 255));
    clip->opacity()->setDefaultValue(0.5);
    clip->opacity()->addKeyFrame(RationalTime(40), 1.0, RationalTime(SafeRational(15, 2)));
    const auto fade = clip->opacity()->keyframeAtTime(RationalTime(40));
    fade->setInterpolater(EaseOutInterpolater<double>::getInstance());
    fade->addMetaData("label", "fade \"in\"");
    clip->geometryCropParam()->setDefaultValue(Rect<float>(0.25f, 0, 1, 0.5f));
    clip->translation()->setDefaultValue(Point3d(1, -2, 0.5));
    const auto opacity = boost::dynamic_pointer_cast<ParameterImpl<double>>(clip->opacity());
    opacity->setValueBounds(0.0, 2.0, 1.0);
    opacity->setUIHints("slider", "percent");
    clip->addMetaData("origin", "import");

    const std::string expected = R"({
    "id" : 1,
    "_type" : "PlaceholderMedia",
    "attributes" : {
      "ident" : "",
      "color" : [1, 2, 3, 255],
      "gain" : 0.75,
      "mixToMono" : true,
      "note" : "take \"2\"",
      "sourceFileOffset" : 9000000000
    },
    "start" : 100,
    "duration" : 100,
    "mediaStart" : "1/3",
    "mediaDuration" : 50,
    "scalar" : 2,
    "parameters" : {
      "geometryCropParam" : [0.25, 0.0, 1.0, 0.5],
      "opacity" : {
        "type" : "double",
        "interp" : "linr",
        "valueBounds" : {
          "minValue" : 0.0,
          "maxValue" : 2.0,
          "defaultValue" : 1.0
        },
        "uiHints" : {
          "userInterfaceType" : "slider",
          "unitType" : "percent"
        },
        "keyframes" : [
          {
            "time" : 0,
            "endTime" : 0,
            "value" : 0.5,
            "duration" : 0
          },
          {
            "time" : "65/2",
            "endTime" : 40,
            "value" : 1.0,
            "duration" : "15/2",
            "interp" : "esOt",
            "metadata" : {
              "label" : "fade \"in\""
            }
          }
        ]
      },
      "translation" : [1.0, -2.0, 0.5]
    },
    "metadata" : {
      "origin" : "import"
    }
  })";
    EXPECT_EQ(written(*clip, 1), expected);
}
