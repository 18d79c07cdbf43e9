#include "util/dos_time.h"

namespace LumenUtility {

DosTimestamp ToDosTimestamp(std::time_t t) {
  std::tm local{};
  DosTimestamp result;
  if (!localtime_r(&t, &local)) return result;
  result.daylight = local.tm_isdst > 0 ? 1 : 0;
  const int year = local.tm_year + 1900;
  if (year < 1980) {
    local = std::tm{};
    local.tm_year = 80;
    local.tm_mday = 1;
  } else if (year > 2107) {
    local = std::tm{};
    local.tm_year = 207;
    local.tm_mon = 11;
    local.tm_mday = 31;
    local.tm_hour = 23;
    local.tm_min = 59;
    local.tm_sec = 58;
  }
  result.time =
      static_cast<std::uint16_t>(local.tm_hour * 2048 + local.tm_min * 32 + local.tm_sec / 2);
  result.date = static_cast<std::uint16_t>((local.tm_year - 80) * 512 + (local.tm_mon + 1) * 32 +
                                           local.tm_mday);
  return result;
}

std::time_t FromDosTimestamp(std::uint16_t time, std::uint16_t date, int daylight) {
  std::tm local{};
  local.tm_sec = (time & 0x1F) * 2;
  local.tm_min = (time >> 5) & 0x3F;
  local.tm_hour = time >> 11;
  local.tm_mday = date & 0x1F;
  local.tm_mon = ((date >> 5) & 0x0F) - 1;
  local.tm_year = (date >> 9) + 80;
  local.tm_isdst = daylight;
  return std::mktime(&local);
}

}  // namespace LumenUtility
