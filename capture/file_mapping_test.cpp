#include "lumen/capture/file_mapping.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <sys/wait.h>

#include <memory>
#include <string>

#include "capture/shm_test_util.h"
#include "lumen/capture/file_mapping_reader.h"
#include "lumen/capture/file_mapping_with_view.h"
#include "lumen/platform/error_codes.h"

namespace LumenUtility {
namespace {

using testutil::BlockNameExists;
using testutil::ThrownCode;
using testutil::UniqueBlockName;

TEST(FileMapping, TwoViewsOfOneNameShareTheMemory) {
  const std::wstring name = UniqueBlockName("share");
  {
    FileMappingWithView<float> first(name, 16);
    FileMappingWithView<float> second(name, 8);  // a smaller view of the same object
    EXPECT_EQ(first.GetCount(), 16);
    EXPECT_EQ(*first.GetPtr(15), 0.0f);  // new memory reads as zero
    *first.GetPtr(7) = 2.5f;
    EXPECT_EQ(*second.GetPtr(7), 2.5f);
    *second.GetPtr(0) = -1.0f;
    EXPECT_EQ(*first.GetPtr(0), -1.0f);
    const FileMappingReader reader(name);
    EXPECT_EQ(reader.GetCount(), 16);
    EXPECT_EQ(*reader.GetPtr(7), 2.5f);
  }
  EXPECT_FALSE(BlockNameExists(name));
}

TEST(FileMapping, NameGoesWithTheLastHolderAndReadersKeepTheirView) {
  const std::wstring name = UniqueBlockName("last-holder");
  const std::wstring other = UniqueBlockName("other");
  auto writer = std::make_unique<FileMappingWithView<float>>(name, 4);
  auto copy = std::make_unique<FileMapping>(name, 16);
  *writer->GetPtr(3) = 42.0f;
  const FileMappingReader reader(name);
  {
    const FileMapping second(*copy);
    EXPECT_NE(second.GetHandle(), copy->GetHandle());  // a descriptor of its own
  }
  writer.reset();
  EXPECT_TRUE(BlockNameExists(name));  // the copy still holds it

  // Assignment lets go of the old object and holds the new one.
  FileMapping assigned(other, 4);
  assigned = *copy;
  EXPECT_FALSE(BlockNameExists(other));
  copy.reset();
  EXPECT_TRUE(BlockNameExists(name));
  const FileMapping& same = assigned;
  assigned = same;
  EXPECT_TRUE(BlockNameExists(name));
  assigned = FileMapping(other, 4);
  EXPECT_FALSE(BlockNameExists(name));
  EXPECT_TRUE(BlockNameExists(other));
  EXPECT_EQ(*reader.GetPtr(3), 42.0f);  // the memory lives on behind the view
}

TEST(FileMapping, NewObjectsAreForTheOwnerOnly) {
  const std::wstring name = UniqueBlockName("mode");
  const FileMapping mapping(name, 64);
  struct stat status {};
  ASSERT_EQ(fstat(mapping.GetHandle(), &status), 0);
  EXPECT_EQ(status.st_mode & 0777, 0600u);
  EXPECT_EQ(status.st_size, 64);
}

TEST(FileMapping, BadNamesAndSizesThrowTheirErrnoCodes) {
  const std::int32_t invalidName = static_cast<std::int32_t>(0x80070016);  // EINVAL
  for (const std::wstring& name : {std::wstring(), std::wstring(L"a/b"), std::wstring(L"/lead"),
                                   std::wstring(L"nul\0name", 8)}) {
    EXPECT_EQ(ThrownCode([&] { FileMapping(name, 4); }), invalidName);
    EXPECT_EQ(ThrownCode([&] { FileMappingWithView<float>(name, 4); }), invalidName);
    EXPECT_EQ(ThrownCode([&] { FileMappingReader{name}; }), invalidName);
  }
  // Longer than a file name may be: the system's own code (EINVAL or ENAMETOOLONG).
  const std::int32_t tooLong = ThrownCode([] { FileMapping(std::wstring(300, L'n'), 4); });
  EXPECT_TRUE(tooLong == invalidName || tooLong == static_cast<std::int32_t>(0x80070024))
      << std::hex << tooLong;

  const std::wstring name = UniqueBlockName("sizes");
  for (std::int64_t count : {std::int64_t{0}, std::int64_t{-4}, std::int64_t{1} << 62}) {
    EXPECT_EQ(ThrownCode([&] { FileMappingWithView<float>(name, count); }), E_INVALIDARG) << count;
  }
  EXPECT_EQ(ThrownCode([&] { FileMapping(name, 0); }), E_INVALIDARG);
  EXPECT_FALSE(BlockNameExists(name));
}

TEST(FileMapping, ExistingObjectSmallerThanAskedIsRefused) {
  const std::wstring name = UniqueBlockName("small");
  FileMappingWithView<float> block(name, 4);
  EXPECT_EQ(ThrownCode([&] { FileMappingWithView<float>(name, 5); }),
            static_cast<std::int32_t>(0x80070011));  // EEXIST
  EXPECT_EQ(ThrownCode([&] { FileMappingWithView<float>(name, 4); }), 0);
  EXPECT_TRUE(BlockNameExists(name));  // a refused open takes nothing away
}

TEST(FileMapping, MemoryBeyondWhatIsLeftIsRefusedUpFront) {
  struct statvfs fs {};
  const std::int64_t oneTerabyte = std::int64_t{1} << 40;
  // Only where the shared-memory file system states a smaller limit: then the reservation
  // fails at once instead of taking the machine's memory.
  if (statvfs("/dev/shm", &fs) != 0 || fs.f_blocks == 0 ||
      static_cast<std::int64_t>(fs.f_blocks) * static_cast<std::int64_t>(fs.f_frsize) >=
          oneTerabyte) {
    GTEST_SKIP() << "no size limit on /dev/shm below 1 TB";
  }
  const std::wstring name = UniqueBlockName("too-large");
  EXPECT_EQ(ThrownCode([&] { FileMappingWithView<float>(name, oneTerabyte / 4); }),
            static_cast<std::int32_t>(0x8007001C));  // ENOSPC
  EXPECT_FALSE(BlockNameExists(name));
}

TEST(FileMappingReader, MissingBlockIsNotFoundAndOddSizesAreWholeFloats) {
  EXPECT_EQ(ThrownCode([] { FileMappingReader{UniqueBlockName("missing")}; }),
            static_cast<std::int32_t>(0x80070002));  // ENOENT

  // Objects another program made: 10 bytes and none at all.
  for (const off_t bytes : {off_t{10}, off_t{0}}) {
    const std::wstring name = UniqueBlockName("raw");
    const std::string object = "/" + WideToUtf8(name);
    const int fd = shm_open(object.c_str(), O_RDWR | O_CREAT | O_EXCL, 0600);
    ASSERT_GE(fd, 0);
    ASSERT_EQ(ftruncate(fd, bytes), 0);
    close(fd);
    {
      const FileMappingReader reader(name);
      EXPECT_EQ(reader.GetByteSize(), bytes);
      EXPECT_EQ(reader.GetCount(), bytes / 4);
    }
    shm_unlink(object.c_str());
  }
}

// Runs `child` in a forked process and returns its exit status (the child never returns into
// the test framework).
template <typename F>
int InChildProcess(F child) {
  const pid_t pid = fork();
  if (pid == 0) _exit(child());
  int status = 0;
  waitpid(pid, &status, 0);
  return WIFEXITED(status) ? WEXITSTATUS(status) : 128;
}

TEST(FileMapping, AnotherProcessSeesAndWritesTheSameFloats) {
  const std::wstring name = UniqueBlockName("two-processes");
  FileMappingWithView<float> block(name, 8);
  *block.GetPtr(2) = 1.25f;
  const int status = InChildProcess([&] {
    // The child opens the block by name, answers in it, and drops a copy of the parent's
    // mapping: a forked process never removes the name its parent created.
    FileMappingWithView<float> view(name, 8);
    const FileMappingReader reader(name);
    if (*view.GetPtr(2) != 1.25f || *reader.GetPtr(2) != 1.25f) return 1;
    *view.GetPtr(3) = 2.75f;
    { FileMapping inherited(name, 4); }
    return 0;
  });
  EXPECT_EQ(status, 0);
  EXPECT_EQ(*block.GetPtr(3), 2.75f);
  EXPECT_TRUE(BlockNameExists(name));
}

}  // namespace
}  // namespace LumenUtility
