// The entry names in the listing the archiver prints for "7za l".
#pragma once

#include <string>
#include <vector>

namespace LumenUtility {

// Appends to `names` the name of every line between the first two lines that contain
// "-----": the text from the sixth space-separated piece to the end of the line (after date,
// time, attributes, size and compressed size), trailing spaces dropped, so names with spaces
// stay whole. Lines with fewer than six pieces are skipped.
void AppendListedNames(const std::vector<std::wstring>& lines, std::vector<std::wstring>& names);

}  // namespace LumenUtility
