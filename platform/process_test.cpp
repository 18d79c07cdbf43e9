#include "platform/process.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <fstream>
#include <sstream>
#include <string>

#include "platform/temp_dir.h"
#include "platform/test_files.h"

namespace {

using LumenUtility::RunProcess;
using LumenUtility::testutil::ReadFileBytes;
using LumenUtility::testutil::TempDir;

TEST(RunProcess, PassesArgumentsVerbatimAndReturnsTheExitStatus) {
  TempDir dir;
  const std::string out = dir.NarrowPath("out.txt");
  const int fd = open(out.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0600);
  ASSERT_GE(fd, 0);
  // Characters a shell would act on arrive unchanged: nothing is run through a shell.
  const auto status = RunProcess(
      L"/bin/sh",
      {L"-c", L"printf '%s|' \"$@\"; pwd; exit 3", L"sh", L"a b", L"$HOME", L";rm -rf x", L"*"},
      dir.Path(""), fd);
  close(fd);
  ASSERT_TRUE(status.has_value());
  EXPECT_EQ(*status, 3);
  char real[4096];
  ASSERT_NE(realpath(dir.NarrowPath("").c_str(), real), nullptr);
  EXPECT_EQ(ReadFileBytes(out), std::string("a b|$HOME|;rm -rf x|*|") + real + "\n");
}

TEST(RunProcess, StandardErrorGoesWithStandardOutputAndInputIsEmpty) {
  TempDir dir;
  const std::string out = dir.NarrowPath("out.txt");
  const int fd = open(out.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0600);
  ASSERT_GE(fd, 0);
  const auto status = RunProcess(
      L"sh", {L"-c", L"echo one; echo two >&2; read answer || exit 1; echo \"[$answer]\""}, L"",
      fd);
  close(fd);
  EXPECT_EQ(status, 1);  // `read` met the end of its input at once
  EXPECT_EQ(ReadFileBytes(out), "one\ntwo\n");
}

TEST(RunProcess, ProgramsThatDoNotStartOrExitGiveNoStatus) {
  TempDir dir;
  EXPECT_EQ(RunProcess(dir.Path("no-such-program"), {}, L""), std::nullopt);
  EXPECT_EQ(RunProcess(L"/bin/true", {}, dir.Path("no-such-directory")), std::nullopt);
  EXPECT_EQ(RunProcess(L"/bin/sh", {L"-c", L"kill -TERM $$"}, L""), std::nullopt);
  EXPECT_EQ(RunProcess(L"/bin/true", {}, L""), 0);
}

}  // namespace
