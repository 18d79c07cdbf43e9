// DOS date and time of ZIP entries: local wall-clock time to two seconds, with the daylight
// saving flag that tells the two occurrences of an hour repeated in autumn apart.
#pragma once

#include <cstdint>
#include <ctime>

namespace LumenUtility {

struct DosTimestamp {
  std::uint16_t time = 0;  // hour x 2048 + minute x 32 + second / 2
  std::uint16_t date = 0;  // (year - 1980) x 512 + month x 32 + day
  int daylight = 0;        // 1 when daylight saving time was in effect, else 0
};

// `t` in the local time zone. Times before 1980-01-01 00:00:00 and after 2107-12-31 23:59:58
// local time, which the 7-bit year cannot hold, become those limits; odd seconds round down.
DosTimestamp ToDosTimestamp(std::time_t t);

// The moment of a DOS date and time read as local time. `daylight` is 1 or 0 when known, -1
// to let the time zone rules decide (for entries without the flag). Field values out of their
// ranges (month 0, second 62) carry over as mktime carries them. Returns -1 when the time
// cannot be represented.
std::time_t FromDosTimestamp(std::uint16_t time, std::uint16_t date, int daylight);

}  // namespace LumenUtility
