// Reading error codes typed on the command line or copied out of logs.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace lumenutil {

// Reads a 32-bit code written in hexadecimal with a 0x or 0X prefix ("0xE8080882"), or in
// decimal, signed or unsigned ("-402102142", "3892838274"). Returns nothing for anything
// else: empty text, other characters, a sign on a hexadecimal code, or a value that does
// not fit in 32 bits (as signed or as unsigned).
std::optional<std::int32_t> ParseHResultCode(std::string_view text);

}  // namespace lumenutil
