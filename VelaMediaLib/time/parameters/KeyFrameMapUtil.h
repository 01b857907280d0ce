#pragma once

#include <VelaMediaLib/base/detail/Int128.h>
#include <VelaMediaLib/time/rational/RationalTime.h>

#include <algorithm>
#include <boost/shared_ptr.hpp>
#include <utility>
#include <vector>

namespace VelaMediaLib {

/// A parameter's keyframes: a map from end time to keyframe, kept as a
/// vector sorted by time so that lookups are binary searches over memory
/// that lies together.
template <typename K>
struct KeyFrameEntry {
    KeyFrameEntry(const RationalTime& at, boost::shared_ptr<K> frame)
        : time(at), keyframe(std::move(frame)), seconds(at.asDouble()) {}

    RationalTime time;
    boost::shared_ptr<K> keyframe;
    /// The time as a double: a query finds its place among these with cheap
    /// comparisons, and the exact times settle the place.
    double seconds;
};

template <typename K>
class KeyFrameMapUtil {
public:
    typedef std::vector<KeyFrameEntry<K>> Map;
    typedef typename Map::iterator Iterator;
    typedef typename Map::const_iterator ConstIterator;

    /// The first entry whose time is not less than t.
    static ConstIterator firstAtOrAfter(const Map& map, const RationalTime& t) {
        return std::lower_bound(
            map.begin(), map.end(), t,
            [](const KeyFrameEntry<K>& entry, const RationalTime& time) { return entry.time < time; });
    }
    /// firstAtOrAfter for a query: a search of the entries' seconds for the
    /// time's, then exact steps at the found place, which a double that
    /// rounds the same as a neighbour's might leave one or two entries off.
    static ConstIterator locate(const Map& map, const RationalTime& t, double seconds) {
        ConstIterator at =
            std::lower_bound(map.begin(), map.end(), seconds,
                             [](const KeyFrameEntry<K>& entry, double s) { return entry.seconds < s; });
        while (at != map.begin() && !less(std::prev(at)->time, t)) --at;
        while (at != map.end() && less(at->time, t)) ++at;
        return at;
    }
    static Iterator firstAtOrAfter(Map& map, const RationalTime& t) {
        return std::lower_bound(
            map.begin(), map.end(), t,
            [](const KeyFrameEntry<K>& entry, const RationalTime& time) { return entry.time < time; });
    }
    /// The first entry whose time is greater than t.
    static ConstIterator firstAfter(const Map& map, const RationalTime& t) {
        return std::upper_bound(
            map.begin(), map.end(), t,
            [](const RationalTime& time, const KeyFrameEntry<K>& entry) { return time < entry.time; });
    }
    /// The entry at exactly t, or end.
    static ConstIterator find(const Map& map, const RationalTime& t) {
        const ConstIterator found = firstAtOrAfter(map, t);
        return found != map.end() && found->time == t ? found : map.end();
    }
    static Iterator find(Map& map, const RationalTime& t) {
        const Iterator found = firstAtOrAfter(map, t);
        return found != map.end() && found->time == t ? found : map.end();
    }
    /// Puts the keyframe at t, replacing whatever stood there; returns what it replaced.
    static boost::shared_ptr<K> put(Map& map, const RationalTime& t, const boost::shared_ptr<K>& keyframe) {
        const Iterator at = firstAtOrAfter(map, t);
        if (at != map.end() && at->time == t) {
            boost::shared_ptr<K> replaced = at->keyframe;
            at->keyframe = keyframe;
            return replaced;
        }
        map.insert(at, KeyFrameEntry<K>{t, keyframe});
        return boost::shared_ptr<K>();
    }
    /// Whether any keyframe lies in [start, start + duration].
    static bool anyInRange(const Map& map, const RationalTime& start, const RationalTime& end) {
        const ConstIterator first = firstAtOrAfter(map, start);
        return first != map.end() && first->time <= end;
    }

private:
    /// Exact a < b without a call: denominators are positive.
    static bool less(const RationalTime& a, const RationalTime& b) {
        const SafeRational x = a.asRational(), y = b.asRational();
        return detail::Int128(x.numerator()) * y.denominator() <
               detail::Int128(y.numerator()) * x.denominator();
    }
};

} // namespace VelaMediaLib
