// Recalls a property bag from the input through a CArchive, then saves what was recalled and
// recalls and saves it again into a fresh bag: the two saves must give the same bytes.
#include <cstddef>
#include <cstdint>
#include <vector>

#include <boost/make_shared.hpp>

#include "lumen/platform.h"
#include "lumen/propertybag.h"
#include "propertybag/test_items.h"

namespace {

using LumenUtility::PropertyBag;
using LumenUtility::testutil::RecordingItem;
using LumenUtility::testutil::SilentItem;

PropertyBag KnownBag() {
  PropertyBag bag;
  for (const char* key : {"Power", "Points", "Span", ""}) {
    bag.AddItem(key, boost::make_shared<RecordingItem>());
  }
  bag.AddItem("UnguidedIsolationORRIN", boost::make_shared<SilentItem>());
  return bag;
}

std::vector<std::uint8_t> Saved(PropertyBag& bag) {
  CMemFile file;
  CArchive ar(&file, CArchive::store);
  bag.SaveContext(ar);
  ar.Close();
  return file.Detach();
}

void Recall(PropertyBag& bag, const std::uint8_t* data, std::size_t size) {
  CMemFile file(data, size);
  CArchive ar(&file, CArchive::load);
  bag.RecallContext(ar);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  PropertyBag bag = KnownBag();
  try {
    Recall(bag, data, size);
  } catch (const CArchiveException&) {
    return 0;  // short archive or unknown key: documented rejections
  }
  const std::vector<std::uint8_t> first = Saved(bag);
  PropertyBag again = KnownBag();
  Recall(again, first.data(), first.size());
  if (Saved(again) != first) __builtin_trap();
  return 0;
}
