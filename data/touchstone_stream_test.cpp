// Streamed reading must be invisible: text read in chunks of any size parses to the same
// content, and fails with the same message, as the same text held in memory.
#include <gtest/gtest.h>

#include <unistd.h>

#include <algorithm>
#include <string>
#include <thread>
#include <vector>

#include "data/testing/chunk_source.h"
#include "data/touchstone_parser.h"
#include "lumen/data.h"

namespace LumenUtility {
namespace {

using fixtures::ChunkSource;

struct Outcome {
  bool read;
  std::string error;
  TouchstoneContent content;
};

Outcome ParseInMemory(std::string_view text, int ports) {
  Outcome o;
  TouchstoneParser parser(text, ports);
  o.read = parser.Parse(o.content);
  o.error = parser.Error();
  return o;
}

Outcome ParseStreamed(std::string_view text, int ports, std::size_t chunk) {
  Outcome o;
  ChunkSource source(text, chunk);
  TouchstoneParser parser(source, ports);
  o.read = parser.Parse(o.content);
  o.error = parser.Error();
  return o;
}

const char* const kTexts[] = {
    "! two-port\n# GHZ S MA R 50\n1 0.5 0 0.1 90 0.2 0 0.4 45\n2 0.6 10 0.3 80 0.2 5 0.5 40\n",
    "\xEF\xBB\xBF# Hz RI\r\n1 1 0 0 0 0 0 0 0\r\n\r\n2 2 0 0 0 0 0 0 0\r\n",
    "! old Mac\r# Hz RI\r1 1 0 0 0 0 0 0 0\r2 2 0 0 0 0 0 0 0\r",
    "[Version] 2.0\n# GHz S MA R 50\n[Number of Ports] 2\n[Two-Port Data Order] 12_21\n"
    "[Number of Frequencies] 2\n[Reference]\n 50 ! Port[1]\n 75 ! Port[2]\n[Network Data]\n"
    "1 0.5 0 0.2 0 0.1 90 0.4 45\n2 0.6 10 0.2 5 0.3 80 0.5 40\n[Noise Data]\n1 3 0.5 45 0.2\n"
    "[End]\n",
    "# GHZ S MA R 50\n1 0.5 0!c\n 0.1 90 0.2 0 0.4 45\n2 0.6 10 0.3 80 0.2 5 0.5 40\n"
    "! Noise Parameters\n1 2 0.5 45 0.2\n2 3 0.4 40 0.3\n",
    "# GHz RI\n1 0.5 0 1e39 0 0 0 0 0\n",
    "# GHz RI\n1 0.5 0 0 0 0 0 0 0\n2 0.5 x\n",
    "[Version] 2.0\n# Hz RI\n[Number of Ports] 1\n[Number of Frequencies] 4\n[Network Data]\n"
    "1 1 0\n",
    "\xFF\xFE# Hz\n",
    "\xEF\xBB# Hz\n",
    "[Version] 2.0\n# Hz RI\n[Number of Ports 1\n",
    "",
    "# Hz RI R",
};

TEST(TouchstoneStream, AnyChunkingGivesWhatTheTextInMemoryGives) {
  for (const char* text : kTexts) {
    const Outcome expected = ParseInMemory(text, 2);
    for (std::size_t chunk : {1, 2, 3, 7, 64, 1 << 20}) {
      const Outcome got = ParseStreamed(text, 2, chunk);
      SCOPED_TRACE(std::string(text) + " in chunks of " + std::to_string(chunk));
      EXPECT_EQ(got.read, expected.read);
      EXPECT_EQ(got.error, expected.error);
      EXPECT_EQ(got.content.stimulus, expected.content.stimulus);
      EXPECT_EQ(got.content.values, expected.content.values);
      EXPECT_EQ(got.content.noise, expected.content.noise);
      EXPECT_EQ(got.content.pointLines, expected.content.pointLines);
      EXPECT_EQ(got.content.info.portReferences, expected.content.info.portReferences);
    }
  }
}

TEST(TouchstoneStream, ALineOrValueOverOneMebibyteIsRefusedNotHeld) {
  const std::string longValue = "# Hz RI\n1 " + std::string(3 << 20, '1') + " 0\n";
  Outcome o = ParseStreamed(longValue, 1, 1 << 16);
  EXPECT_FALSE(o.read);
  EXPECT_EQ(o.error, "line 2: a line or value longer than 1 MiB is not read");
  const std::string longComment = "! " + std::string(3 << 20, 'c') + "\n# Hz RI\n1 1 0\n";
  o = ParseStreamed(longComment, 1, 1 << 16);
  EXPECT_EQ(o.error, "line 1: a line or value longer than 1 MiB is not read");
  // Skipped lines are not held, whatever their length.
  const std::string longInformation = "[Version] 2.0\n# Hz RI\n[Number of Ports] 1\n"
                                      "[Begin Information] " + std::string(3 << 20, 'i') +
                                      "\n[End Information]\n[Network Data]\n1 1 0\n";
  o = ParseStreamed(longInformation, 1, 1 << 16);
  EXPECT_TRUE(o.read) << o.error;
}

TEST(TouchstoneStream, ReadsAPipeToItsEnd) {
  int fds[2];
  ASSERT_EQ(::pipe(fds), 0);
  std::string text = "# Hz RI\n";
  // More than the pipe holds at once (64 KiB), so the reader meets partial reads.
  for (int i = 1; i <= 20000; ++i) text += std::to_string(i) + " 0.5 -0.25\n";
  std::thread writer([&] {
    std::size_t done = 0;
    while (done < text.size()) {
      const ssize_t n = ::write(fds[1], text.data() + done, std::min<std::size_t>(999, text.size() - done));
      if (n <= 0) break;
      done += static_cast<std::size_t>(n);
    }
    ::close(fds[1]);
  });
  CSnPFileBase file(1);
  EXPECT_EQ(file.ReadSNPDescriptor(fds[0]), 20000);
  writer.join();
  ::close(fds[0]);
  EXPECT_EQ(file.GetParam(SNP_S11).GetStopFreq(), 20000.0);
  EXPECT_EQ(file.GetFileInfo().pointLines.back(), 20001);
  // A descriptor that cannot be read says why.
  EXPECT_EQ(file.ReadSNPDescriptor(-1), -1);
  EXPECT_EQ(file.GetReadError(), L"the file cannot be read: Bad file descriptor");
}

}  // namespace
}  // namespace LumenUtility
