#pragma once

namespace VelaMediaLib {

/// Why a source is offline, asked in this order: the file is missing, it
/// cannot be read, no stats loader can read it (StatsUnavailable), or it
/// could be brought back online as it is (Reconnectable).
enum class OfflineStatus {
    Online = 0,
    FileMissing = 1,
    FileUnreadable = 2,
    StatsUnavailable = 3,
    Reconnectable = 4
};

} // namespace VelaMediaLib
