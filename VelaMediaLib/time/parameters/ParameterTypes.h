#pragma once
// The value types that parameters exist for, as one list for instantiation.

#include <VelaMediaLib/base/AudioPosition.h>
#include <VelaMediaLib/base/CaptionData.h>
#include <VelaMediaLib/base/KeystrokeData.h>
#include <VelaMediaLib/base/Point3d.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/base/TemplatedColor.h>
#include <VelaMediaLib/base/TextAttributeList.h>
#include <VelaMediaLib/base/TransformMatrix.h>
#include <VelaMediaLib/time/interpolaters/Interpolater.h>
#include <VelaMediaLib/time/rational/SafeRational.h>

#include <list>
#include <string>
#include <vector>

#define VELA_FOR_EACH_PARAMETER_TYPE(X)                                                                      \
    X(int)                                                                                                   \
    X(float)                                                                                                 \
    X(double)                                                                                                \
    X(long long)                                                                                             \
    X(std::string)                                                                                           \
    X(::VelaMediaLib::Rect<float>)                                                                           \
    X(::VelaMediaLib::TemplatedColor<int>)                                                                   \
    X(std::list<::VelaMediaLib::Rect<float>>)                                                                \
    X(::VelaMediaLib::AudioPosition)                                                                         \
    X(::VelaMediaLib::CaptionData)                                                                           \
    X(::VelaMediaLib::KeystrokeData)                                                                         \
    X(::VelaMediaLib::Point3d)                                                                               \
    X(::VelaMediaLib::SafeRational)                                                                          \
    X(::VelaMediaLib::TextAttributeList)                                                                     \
    X(::VelaMediaLib::TransformMatrix)                                                                       \
    X(std::vector<double>)                                                                                   \
    X(boost::shared_ptr<::VelaMediaLib::Interpolater<int>>)                                                  \
    X(boost::shared_ptr<::VelaMediaLib::Interpolater<float>>)                                                \
    X(boost::shared_ptr<::VelaMediaLib::Interpolater<double>>)                                               \
    X(boost::shared_ptr<::VelaMediaLib::Interpolater<::VelaMediaLib::Rect<float>>>)                          \
    X(boost::shared_ptr<::VelaMediaLib::Interpolater<::VelaMediaLib::TemplatedColor<int>>>)                  \
    X(boost::shared_ptr<::VelaMediaLib::Interpolater<::VelaMediaLib::Point3d>>)
