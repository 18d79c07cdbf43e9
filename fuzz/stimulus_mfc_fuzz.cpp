// Reads the rest of the input through a CArchive (first byte's low bit): as an array in its
// MFC form, stored and loaded again to the same bytes; or as wide strings and 32-bit values
// until the archive ends.
#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "lumen/platform.h"
#include "lumen/stimulus.h"

namespace {

std::vector<std::uint8_t> Stored(LumenUtility::InputArray& array) {
  CMemFile file;
  CArchive ar(&file, CArchive::store);
  ar << array;
  ar.Close();
  return file.Detach();
}

void LoadArray(const std::uint8_t* data, std::size_t size) {
  LumenUtility::InputArray array;
  try {
    CMemFile file(data, size);
    CArchive ar(&file, CArchive::load);
    ar >> array;
  } catch (const LumenException&) {
    return;  // documented rejections
  } catch (const CArchiveException&) {
    return;
  }
  const std::vector<std::uint8_t> first = Stored(array);
  LumenUtility::InputArray again;
  CMemFile file(first);
  CArchive ar(&file, CArchive::load);
  ar >> again;
  if (Stored(again) != first) __builtin_trap();
}

void LoadValues(const std::uint8_t* data, std::size_t size) {
  CMemFile file(data, size);
  CArchive ar(&file, CArchive::load);
  try {
    for (;;) {
      std::wstring text;
      std::int32_t value;
      ar >> text >> value;
    }
  } catch (const CArchiveException&) {
    // The end of the data.
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size == 0) return 0;
  if (data[0] & 1) {
    LoadValues(data + 1, size - 1);
  } else {
    LoadArray(data + 1, size - 1);
  }
  return 0;
}
