#include "lumen/util/file_search.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <fstream>

#include "platform/temp_dir.h"
#include "util/wildcard_match.h"

namespace {

using LumenUtility::FileSearch;
using LumenUtility::testutil::TempDir;
using Paths = std::vector<std::wstring>;

class FileSearchTest : public ::testing::Test {
 protected:
  // Creates the file `name` (and its directories) below the scratch directory.
  void Touch(const std::string& name) {
    std::filesystem::create_directories(std::filesystem::path(dir.NarrowPath(name)).parent_path());
    std::ofstream(dir.NarrowPath(name)) << name;
  }
  Paths Find(const std::string& pattern, FileSearch::RecurseSubDirs recurse) {
    return FileSearch(dir.Path(pattern).c_str(), recurse).GetResults();
  }
  Paths Sorted(Paths paths) {
    std::sort(paths.begin(), paths.end());
    return paths;
  }
  std::wstring P(const std::string& name) { return dir.Path(name); }

  TempDir dir;
};

TEST_F(FileSearchTest, SubdirectoryMatchesComeBeforeTheDirectorysOwn) {
  for (const char* name : {"a/x.txt", "a/sub/y.txt", "a/sub/deeper/z.txt", "a/other.csv"})
    Touch(name);
  EXPECT_EQ(Find("a/*.txt", FileSearch::Recurse),
            (Paths{P("a/sub/deeper/z.txt"), P("a/sub/y.txt"), P("a/x.txt")}));
  EXPECT_EQ(Find("a/*.txt", FileSearch::NoRecurse), (Paths{P("a/x.txt")}));
  EXPECT_EQ(Find("a/*.txt", static_cast<FileSearch::RecurseSubDirs>(7)), (Paths{P("a/x.txt")}));
}

TEST_F(FileSearchTest, StarDotStarListsEveryNameAndTheDotEntries) {
  for (const char* name : {"a/noext", "a/x.txt", "a/d/inner"}) Touch(name);
  EXPECT_EQ(Sorted(Find("a/*.*", FileSearch::NoRecurse)),
            (Paths{P("a/."), P("a/.."), P("a/d"), P("a/noext"), P("a/x.txt")}));
  const Paths all = Find("a/*.*", FileSearch::Recurse);
  ASSERT_EQ(all.size(), 8u);
  EXPECT_EQ(Sorted(Paths(all.begin(), all.begin() + 3)),
            (Paths{P("a/d/."), P("a/d/.."), P("a/d/inner")}));
  // `*.` is no special case: it wants a name ending in a dot.
  EXPECT_EQ(Sorted(Find("a/*.", FileSearch::NoRecurse)), (Paths{P("a/."), P("a/..")}));
}

TEST_F(FileSearchTest, SecondSearchReplacesTheResults) {
  Touch("a/x.txt");
  Touch("a/y.csv");
  FileSearch search(P("a/*.txt").c_str(), FileSearch::NoRecurse);
  search.Search(P("a/*.csv").c_str(), FileSearch::NoRecurse);
  EXPECT_EQ(search.GetResults(), (Paths{P("a/y.csv")}));
  search.Search(P("missing/*.csv").c_str(), FileSearch::Recurse);
  EXPECT_TRUE(search.GetResults().empty());
  search.Search(P("a/").c_str(), FileSearch::NoRecurse);  // an empty pattern matches nothing
  EXPECT_TRUE(search.GetResults().empty());
  search.Search(nullptr, FileSearch::Recurse);
  EXPECT_TRUE(search.GetResults().empty());
}

TEST_F(FileSearchTest, PatternWithoutDirectoryListsNamesOfTheCurrentDirectory) {
  Touch("x.txt");
  Touch("sub/y.txt");
  const std::filesystem::path before = std::filesystem::current_path();
  std::filesystem::current_path(dir.NarrowPath(""));
  const Paths found = FileSearch(L"*.txt", FileSearch::Recurse).GetResults();
  std::filesystem::current_path(before);
  EXPECT_EQ(found, (Paths{L"sub/y.txt", L"x.txt"}));
}

TEST_F(FileSearchTest, LinksToDirectoriesAreFollowedButNotRoundACycle) {
  Touch("a/x.txt");
  Touch("b/y.txt");
  std::filesystem::create_directory_symlink(dir.NarrowPath("b"), dir.NarrowPath("a/to_b"));
  std::filesystem::create_directory_symlink(dir.NarrowPath("a"), dir.NarrowPath("a/back"));
  std::filesystem::create_directory_symlink(dir.NarrowPath("a"), dir.NarrowPath("b/up"));
  // b/up leads back into a, where the search already is.
  EXPECT_EQ(Find("a/*.txt", FileSearch::Recurse), (Paths{P("a/to_b/y.txt"), P("a/x.txt")}));
}

TEST(CreateSearchPattern, JoinsWithOneSlash) {
  EXPECT_EQ(FileSearch::CreateSearchPattern(L"/data", L"*.s2p"), L"/data/*.s2p");
  EXPECT_EQ(FileSearch::CreateSearchPattern(L"/data/", L"*.s2p"), L"/data/*.s2p");
  EXPECT_EQ(FileSearch::CreateSearchPattern(L"", L"*.s2p"), L"*.s2p");
  EXPECT_EQ(FileSearch::CreateSearchPattern(nullptr, nullptr), L"");
}

TEST(MatchesWildcard, StarQuestionMarkAndCaselessLetters) {
  using LumenUtility::MatchesWildcard;
  struct Case {
    const wchar_t* name;
    const wchar_t* pattern;
    bool matches;
  } cases[] = {
      {L"a.csv", L"*.csv", true},   {L"A.CSV", L"*.csv", true},
      {L"a.csvx", L"*.csv", false}, {L".csv", L"*.csv", true},
      {L"noext", L"*.*", true},     {L"noext", L"*.", false},
      {L"ab", L"a?", true},         {L"a", L"a?", false},
      {L"abc", L"a?", false},       {L"aXbXc", L"a*b*c", true},
      {L"aXbXd", L"a*b*c", false},  {L"", L"*", true},
      {L"x", L"", false},           {L"été.txt", L"?t?.TXT", true},
      {L"Été", L"été", false},      {L"aaaaaaaaab", L"*a*a*a*b", true},
  };
  for (const Case& c : cases)
    EXPECT_EQ(MatchesWildcard(c.name, c.pattern), c.matches) << c.name << " " << c.pattern;
}

}  // namespace
