#pragma once

#include <VelaMediaLib/base/detail/Int128.h>
#include <VelaMediaLib/time/rational/RationalTime.h>

#include <algorithm>
#include <boost/shared_ptr.hpp>
#include <cstddef>
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
    /// comparisons, and the exact times settle the place (so a stale value
    /// would cost speed, never exactness). Set with the time; entries are
    /// replaced whole, never retimed in place.
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
    /// firstAtOrAfter for a query: a binary search of the entries' seconds
    /// for the time's, then exact steps at the found place. Doubles of times
    /// closer than a double can tell apart may tie or even fall out of order
    /// (a 64-bit numerator rounds on conversion), leaving the place a few
    /// entries off; past a few steps the exact search takes over.
    static ConstIterator locate(const Map& map, const RationalTime& t, double seconds) {
        size_t low = 0, high = map.size(); // a plain halving: defined whatever order the doubles are in
        while (low < high) {
            const size_t middle = low + (high - low) / 2;
            if (map[middle].seconds < seconds)
                low = middle + 1;
            else
                high = middle;
        }
        ConstIterator at = map.begin() + std::ptrdiff_t(low);
        for (int steps = 0; steps < kMaxSteps; ++steps) {
            if (at != map.begin() && !less(std::prev(at)->time, t))
                --at;
            else if (at != map.end() && less(at->time, t))
                ++at;
            else
                return at;
        }
        return firstAtOrAfter(map, t);
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
    static const int kMaxSteps = 4;

    /// Exact a < b without a call: denominators are positive.
    static bool less(const RationalTime& a, const RationalTime& b) {
        const SafeRational x = a.asRational(), y = b.asRational();
        return detail::Int128(x.numerator()) * y.denominator() <
               detail::Int128(y.numerator()) * x.denominator();
    }
};

} // namespace VelaMediaLib
