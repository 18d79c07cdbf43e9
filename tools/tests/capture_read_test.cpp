// `lumenutil capture read` as a client process of the data capture service: this test is the
// service, the tool a separate process that opens the block by name.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <fstream>
#include <iterator>
#include <sstream>
#include <string>
#include <vector>

#include "lumen/capture.h"
#include "lumen/util/host_interfaces.h"
#include "lumen/util/host_object.h"

extern char** environ;

namespace {

struct ToolRun {
  int status = -1;
  std::string out;
  std::string err;
};

std::string FileText(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  return std::string(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
}

// Runs lumenutil with `args` and returns its exit status and output.
ToolRun RunTool(std::vector<std::string> args) {
  const std::string base = "/tmp/lumen-capture-read-" + std::to_string(getpid());
  const std::string outPath = base + ".out", errPath = base + ".err";
  posix_spawn_file_actions_t actions;
  posix_spawn_file_actions_init(&actions);
  posix_spawn_file_actions_addopen(&actions, 1, outPath.c_str(), O_WRONLY | O_CREAT | O_TRUNC,
                                   0600);
  posix_spawn_file_actions_addopen(&actions, 2, errPath.c_str(), O_WRONLY | O_CREAT | O_TRUNC,
                                   0600);
  args.insert(args.begin(), LUMENUTIL_PATH);
  std::vector<char*> argv;
  for (std::string& arg : args) argv.push_back(arg.data());
  argv.push_back(nullptr);
  ToolRun run;
  pid_t pid = 0;
  if (posix_spawn(&pid, LUMENUTIL_PATH, &actions, nullptr, argv.data(), environ) == 0) {
    int status = 0;
    waitpid(pid, &status, 0);
    run.status = WIFEXITED(status) ? WEXITSTATUS(status) : 128;
  }
  posix_spawn_file_actions_destroy(&actions);
  run.out = FileText(outPath);
  run.err = FileText(errPath);
  unlink(outPath.c_str());
  unlink(errPath.c_str());
  return run;
}

// The floats of the tool's lines, each line "a" or "a,b".
std::vector<float> Values(const std::string& text) {
  std::vector<float> values;
  std::istringstream lines(text);
  std::string line;
  while (std::getline(lines, line)) {
    std::istringstream fields(line);
    std::string field;
    while (std::getline(fields, field, ',')) values.push_back(std::strtof(field.c_str(), nullptr));
  }
  return values;
}

class Measurement : public Interface::IGetSetData {
 public:
  void GetFormattedData(int, int, std::vector<float>& out) override { out = formatted; }
  int GetFormat() override { return 1; }
  boost::shared_ptr<LumenUtility::DataMatrix> GetCalData() override { return {}; }
  void GetComplexData(const std::vector<LumenUtility::TsComplex>*& out) override { out = &points; }

  std::vector<LumenUtility::TsComplex> points;
  std::vector<float> formatted;
};

// However the test ends, the service goes and leaves nothing in the shared-memory namespace,
// and the host objects leave the table.
struct ServiceGuard {
  Measurement* measurements[2];
  ~ServiceGuard() {
    DataCapture::Destroy();
    for (Measurement* m : measurements) {
      LumenUtility::RemoveHostObject<Interface::IGetSetData>(LumenUtility::kHostCategoryMeasurement,
                                                             m);
    }
  }
};

TEST(CaptureRead, AnotherProcessReadsTheFloatsTheServiceWroteUntilTheBlockIsGone) {
  Measurement complexData, formattedData;
  const ServiceGuard guard{{&complexData, &formattedData}};
  complexData.points = {{0.1f, -1.0f / 3}, {2.5e-12f, 7e30f}, {-0.0f, 123456.789f}};
  formattedData.formatted = {1.0f / 7, -42.5f, 3e-39f, 16777217.0f};
  LumenUtility::RegisterHostObject<Interface::IGetSetData>(LumenUtility::kHostCategoryMeasurement,
                                                           1, &complexData);
  LumenUtility::RegisterHostObject<Interface::IGetSetData>(LumenUtility::kHostCategoryMeasurement,
                                                           2, &formattedData);
  DataCapture::Create();
  DataCapture& service = DataCapture::Instance();
  service.Initialize();
  ASSERT_EQ(service.AddRequest(L"1:1:SDATA:3"), 0u);
  ASSERT_EQ(service.AddRequest(L"1:2:FDATA:4"), 6u);
  const std::wstring name = service.GenerateName();
  std::string narrowName(name.begin(), name.end());
  service.CommitDataRequest(name);
  DataCapture::ChannelDataDone(1);

  std::vector<float> all;
  for (const LumenUtility::TsComplex& p : complexData.points) all.insert(all.end(), {p.re, p.im});
  all.insert(all.end(), formattedData.formatted.begin(), formattedData.formatted.end());

  const ToolRun whole = RunTool({"capture", "read", narrowName});
  ASSERT_EQ(whole.status, 0) << whole.err;
  EXPECT_EQ(Values(whole.out), all);  // exactly the floats, every digit carried over
  const ToolRun formatted = RunTool({"capture", "read", narrowName, "--offset", "6"});
  EXPECT_EQ(Values(formatted.out), formattedData.formatted);
  const ToolRun pairs = RunTool({"capture", "read", narrowName, "--complex", "--count", "2"});
  ASSERT_EQ(pairs.status, 0) << pairs.err;
  EXPECT_EQ(pairs.out.substr(0, pairs.out.find('\n')), "0.1,-0.33333334");
  EXPECT_EQ(Values(pairs.out), std::vector<float>(all.begin(), all.begin() + 4));
  EXPECT_EQ(RunTool({"capture", "read", narrowName, "--offset", "10"}).out, "");

  const ToolRun pastEnd = RunTool({"capture", "read", narrowName, "--offset", "11"});
  EXPECT_EQ(pastEnd.status, 1);
  EXPECT_EQ(pastEnd.err,
            "lumenutil: offset 11 is past the end of '" + narrowName + "' (10 floats)\n");
  const ToolRun tooMany =
      RunTool({"capture", "read", narrowName, "--complex", "--offset", "5", "--count", "3"});
  EXPECT_EQ(tooMany.status, 1);
  EXPECT_EQ(tooMany.err, "lumenutil: '" + narrowName +
                             "' holds 10 floats: 3 complex values from offset 5 do not fit\n");
  EXPECT_EQ(RunTool({"capture", "read", narrowName, "--offset", "-1"}).status, 2);

  DataCapture::Destroy();
  const ToolRun gone = RunTool({"capture", "read", narrowName});
  EXPECT_EQ(gone.status, 1);
  EXPECT_EQ(gone.out, "");
  EXPECT_EQ(gone.err, "lumenutil: no shared-memory block named '" + narrowName + "'\n");
  const ToolRun badName = RunTool({"capture", "read", "a/b"});
  EXPECT_EQ(badName.err, "lumenutil: cannot open shared-memory block 'a/b': error 0x80070016\n");
}

}  // namespace
