#pragma once
// Clips with any timing state, for the tests of the timing model.

#include <VelaMediaLib/model/media/AudioMediaImpl.h>
#include <VelaMediaLib/model/media/MediaDispatcher.h>
#include <VelaMediaLib/model/media/VisualMediaImpl.h>
#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>

namespace VelaMediaLib {
namespace testing {

class TestClip : public VisualMediaImpl {
public:
    TestClip(const boost::weak_ptr<const ThreadSafe>& token, const boost::weak_ptr<ProjectEditRate>& rate,
             const MediaState& state, EditorKind editor)
        : Media(token), VisualMedia(token), VisualMediaImpl(token, rate, state, editor) {}
    boost::shared_ptr<Media> clone() const override {
        return boost::make_shared<TestClip>(projectMutex(), projectEditRate(), state(), Temporal);
    }
    void dispatch(MediaDispatcher&) override {}
    void dispatch(ConstMediaDispatcher&) const override {}
};

class TestAudioClip : public AudioMediaImpl {
public:
    TestAudioClip(const boost::weak_ptr<const ThreadSafe>& token, const MediaState& state)
        : Media(token), AudioMedia(token),
          AudioMediaImpl(token, boost::weak_ptr<ProjectEditRate>(), state, Temporal) {}
    boost::shared_ptr<Media> clone() const override {
        return boost::make_shared<TestAudioClip>(projectMutex(), state());
    }
    void dispatch(MediaDispatcher&) override {}
    void dispatch(ConstMediaDispatcher&) const override {}
};

/// start, duration; media start, media duration; scalar; limits.
inline MediaState timing(VelaTime start, VelaTime duration, SafeRational mediaStart,
                         SafeRational mediaDuration, SafeRational scalar, SafeRational minStart,
                         SafeRational maxEnd) {
    MediaState state;
    state.start = start;
    state.duration = duration;
    state.mediaStart = mediaStart;
    state.mediaDuration = mediaDuration;
    state.scalar = scalar;
    state.minMediaStart = minStart;
    state.maxMediaEnd = maxEnd;
    return state;
}

} // namespace testing
} // namespace VelaMediaLib
