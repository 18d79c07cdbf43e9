// Extracts arbitrary bytes, written to a temporary file, as a ZIP archive into a fresh
// directory that holds a link to a directory beside it. Whatever the bytes, nothing may appear
// outside the destination, no temporary file may stay behind, and every name reported as
// extracted must exist.
#include <unistd.h>

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "lumen/platform.h"
#include "lumen/util.h"

namespace {

namespace fs = std::filesystem;

void Check(bool condition) {
  if (!condition) __builtin_trap();
}

// The scratch tree, memory-backed where there is one: every run creates and removes files.
// Made on the first run and removed when the process ends.
class ScratchTree {
 public:
  ScratchTree() {
    const fs::path base =
        fs::is_directory("/dev/shm") ? fs::path("/dev/shm") : fs::temp_directory_path();
    m_path = base / ("unzip_fuzz_" + std::to_string(getpid()));
    fs::remove_all(m_path);
    fs::create_directories(m_path / "outside");
  }
  ~ScratchTree() {
    std::error_code error;
    fs::remove_all(m_path, error);
  }
  const fs::path& Path() const { return m_path; }

 private:
  fs::path m_path;
};

const fs::path& Scratch() {
  static const ScratchTree tree;
  return tree.Path();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const fs::path& scratch = Scratch();
  const fs::path archive = scratch / "in.zip";
  const fs::path dest = scratch / "dest";
  {
    std::ofstream out(archive, std::ios::binary | std::ios::trunc);
    out.write(reinterpret_cast<const char*>(data), static_cast<std::streamsize>(size));
  }
  fs::remove_all(dest);
  fs::create_directories(dest);
  fs::create_directory_symlink(scratch / "outside", dest / "link");

  std::vector<std::wstring> extracted;
  const bool ok = LumenUtility::ZlibUtil::DoUnzip(archive.wstring(), dest.wstring(), &extracted);
  if (ok) {
    for (const std::wstring& name : extracted)
      Check(fs::exists(dest / LumenUtility::WideToUtf8(name)));
  }
  Check(fs::is_empty(scratch / "outside"));
  std::size_t beside = 0;
  for (const auto& entry : fs::directory_iterator(scratch)) {
    (void)entry;
    ++beside;
  }
  Check(beside == 3);  // in.zip, dest, outside
  for (const auto& entry : fs::recursive_directory_iterator(dest)) {
    Check(entry.path().filename().string().rfind(".lumen-unzip-", 0) != 0);
  }
  return 0;
}
