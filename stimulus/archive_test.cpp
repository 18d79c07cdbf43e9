#include "lumen/stimulus/archive.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <cerrno>
#include <string>

#include "lumen/platform/lumen_exception.h"
#include "stimulus/golden_bytes.h"

namespace LumenUtility {
namespace {

using testutil::Bytes;

template <typename F>
std::wstring MessageOf(F f) {
  try {
    f();
  } catch (const LumenException& e) {
    EXPECT_EQ(e.GetCode(), LUMEN_E_BOUNDS);
    return e.GetMessage();
  }
  return L"nothing thrown";
}

// A file of `size` bytes 0, 1, 2, ... (mod 251) opened for reading.
int OpenPatternFile(std::size_t size) {
  char path[] = "/tmp/lumen-archive-XXXXXX";
  const int fd = mkstemp(path);
  unlink(path);
  std::vector<unsigned char> bytes(size);
  for (std::size_t i = 0; i < size; ++i) bytes[i] = static_cast<unsigned char>(i % 251);
  EXPECT_EQ(write(fd, bytes.data(), size), static_cast<ssize_t>(size));
  lseek(fd, 0, SEEK_SET);
  return fd;
}

bool IsOpenDescriptor(int fd) {
  return fcntl(fd, F_GETFD) != -1 || errno != EBADF;
}

TEST(Archive, StoringAppendsLittleEndianValuesAndRefusesReads) {
  Bytes buffer = {0xAA};
  Archive ar(buffer, false);
  EXPECT_TRUE(ar.IsStoring());
  ar << std::uint16_t{1} << 3.5 << std::uint32_t{5} << std::uint8_t{2};
  EXPECT_EQ(buffer, testutil::Golden()
                        .Put<std::uint8_t>(0xAA)
                        .Put<std::uint16_t>(1)
                        .Put(3.5)
                        .Put<std::uint32_t>(5)
                        .Put<std::uint8_t>(2)
                        .bytes);
  std::uint8_t value;
  EXPECT_EQ(MessageOf([&] { ar >> value; }),
            L"Archive Exception: Reading from write-only archive.");
  EXPECT_EQ(MessageOf([&] { ar.CheckFile(); }), L"Archive Exception: Invalid file handle");
}

TEST(Archive, LoadingReadsInOrderAndAShortReadConsumesNothing) {
  Bytes buffer = {0x01, 0x00, 0x07};
  Archive ar(buffer, true);
  EXPECT_EQ(MessageOf([&] { ar << std::uint8_t{1}; }),
            L"Archive Exception: Writing to read-only archive.");
  std::uint16_t version;
  ar >> version;
  EXPECT_EQ(version, 1);
  EXPECT_EQ(ar.Read(nullptr, 0), 0u);
  EXPECT_EQ(MessageOf([&] { ar >> version; }),
            L"Archive Exception: Attempt to read beyond end of buffer.");
  std::uint8_t last;
  ar >> last;  // the failed 2-byte read left the 1 byte there
  EXPECT_EQ(last, 7);

  Bytes one = {0x01};
  Archive tooShort(one, true);
  EXPECT_EQ(MessageOf([&] { tooShort >> version; }),
            L"Archive Exception: Attempt to read beyond end of buffer.");
}

TEST(Archive, RefillsFromTheFileKeepingOnlyUnreadBytesAndClosesItAtTheEnd) {
  constexpr std::size_t kFileBytes = 200 * 1024;
  const int fd = OpenPatternFile(kFileBytes);
  Bytes buffer = {0xEE, 0xFF};
  Archive ar(buffer, true, fd);
  ar.CheckFile();
  std::uint16_t head;
  ar >> head;
  EXPECT_EQ(head, 0xFFEE);
  std::size_t read = 0;
  unsigned char chunk[1000];
  while (read + sizeof chunk <= kFileBytes) {
    ar.Read(chunk, sizeof chunk);
    EXPECT_EQ(chunk[0], read % 251);
    EXPECT_EQ(chunk[999], (read + 999) % 251);
    read += sizeof chunk;
    EXPECT_LE(buffer.size(), 64 * 1024 + sizeof chunk);  // unread bytes plus one refill
  }
  EXPECT_EQ(ar.GetFile(), Archive::kInvalidHandle);  // the short refill showed the end
  EXPECT_FALSE(IsOpenDescriptor(fd));
  ar.Read(chunk, kFileBytes - read);  // the rest comes from the buffer alone
  EXPECT_EQ(MessageOf([&] { ar.Read(chunk, 1); }),
            L"Archive Exception: Attempt to read beyond end of buffer.");
  EXPECT_EQ(MessageOf([&] { ar.CheckFile(); }), L"Archive Exception: Invalid file handle");
}

TEST(Archive, UnreadableFileFailsAndDestructionClosesAnOpenFile) {
  char path[] = "/tmp/lumen-archive-XXXXXX";
  close(mkstemp(path));
  const int writeOnly = open(path, O_WRONLY);
  unlink(path);
  {
    Bytes buffer;
    Archive ar(buffer, true, writeOnly);
    std::uint32_t value;
    EXPECT_EQ(MessageOf([&] { ar >> value; }), L"Archive exception: ReadFile failed");
    EXPECT_TRUE(IsOpenDescriptor(writeOnly));
  }
  EXPECT_FALSE(IsOpenDescriptor(writeOnly));
}

}  // namespace
}  // namespace LumenUtility
