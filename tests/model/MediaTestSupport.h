#pragma once
// What the model's tests share: a project lock and a 30 fps edit rate, clips
// with any timing state, and checks that a refused edit says why and changes nothing.

#include "../ThreadTestSupport.h"

#include <VelaMediaLib/model/media/AudioMediaImpl.h>
#include <VelaMediaLib/model/media/MediaDispatcher.h>
#include <VelaMediaLib/model/media/VisualMediaImpl.h>
#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>
#include <VelaMediaLib/time/sync/Observer.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <optional>
#include <string>

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
    return MediaState{start,    duration, mediaStart, mediaDuration, scalar,
                      minStart, maxEnd,   false,      RationalTime()};
}

class ModelTest : public ::testing::Test {
protected:
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
};

/// The Exception the edit throws; a failure when it throws none.
template <typename Exception, typename Edit>
std::optional<Exception> thrown(Edit edit) {
    try {
        edit();
    } catch (const Exception& e) {
        return e;
    }
    ADD_FAILURE() << "no exception";
    return std::nullopt;
}

/// The edit throws an Exception that says the message.
template <typename Exception, typename Edit>
void expectThrows(const std::string& message, Edit edit) {
    const auto e = thrown<Exception>(edit);
    EXPECT_EQ(std::string(e ? e->what() : ""), message);
}

/// The same, and the clip is left as it was.
template <typename Exception, typename Edit>
void expectRefused(const Media& media, const std::string& message, Edit edit) {
    const MediaState before = media.state();
    expectThrows<Exception>(message, edit);
    EXPECT_TRUE(media.state() == before) << message;
}

typedef CountingObserver Counter;

} // namespace testing
} // namespace VelaMediaLib
