#include "platform/process.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>

#include <cerrno>

#include "lumen/platform/text_conversion.h"

extern char** environ;

namespace LumenUtility {
namespace {

// posix_spawn file actions and attributes, released on every path out.
class SpawnSetup {
 public:
  SpawnSetup() { m_actionsOk = posix_spawn_file_actions_init(&m_actions) == 0; }
  ~SpawnSetup() {
    if (m_actionsOk) posix_spawn_file_actions_destroy(&m_actions);
  }
  SpawnSetup(const SpawnSetup&) = delete;
  SpawnSetup& operator=(const SpawnSetup&) = delete;

  // False when any action could not be recorded.
  bool Prepare(const std::string& workDir, int outputFd) {
    if (!m_actionsOk) return false;
    bool ok = posix_spawn_file_actions_addopen(&m_actions, 0, "/dev/null", O_RDONLY, 0) == 0;
    if (outputFd >= 0) {
      ok = ok && posix_spawn_file_actions_adddup2(&m_actions, outputFd, 1) == 0 &&
           posix_spawn_file_actions_adddup2(&m_actions, outputFd, 2) == 0;
    } else {
      ok = ok && posix_spawn_file_actions_addopen(&m_actions, 1, "/dev/null", O_WRONLY, 0) == 0 &&
           posix_spawn_file_actions_adddup2(&m_actions, 1, 2) == 0;
    }
    if (ok && !workDir.empty())
      ok = posix_spawn_file_actions_addchdir_np(&m_actions, workDir.c_str()) == 0;
    return ok;
  }
  const posix_spawn_file_actions_t* Actions() const { return &m_actions; }

 private:
  posix_spawn_file_actions_t m_actions;
  bool m_actionsOk = false;
};

}  // namespace

std::optional<int> RunProcess(const std::wstring& program,
                              const std::vector<std::wstring>& arguments,
                              const std::wstring& workDir, int outputFd) {
  std::vector<std::string> texts;
  texts.reserve(arguments.size() + 1);
  texts.push_back(WideToUtf8(program));
  for (const std::wstring& argument : arguments) texts.push_back(WideToUtf8(argument));
  std::vector<char*> argv;
  for (std::string& text : texts) argv.push_back(text.data());
  argv.push_back(nullptr);

  SpawnSetup setup;
  if (!setup.Prepare(WideToUtf8(workDir), outputFd)) return std::nullopt;
  pid_t pid;
  if (posix_spawnp(&pid, argv[0], setup.Actions(), nullptr, argv.data(), environ) != 0)
    return std::nullopt;
  int status;
  pid_t waited;
  do {
    waited = waitpid(pid, &status, 0);
  } while (waited < 0 && errno == EINTR);
  if (waited != pid || !WIFEXITED(status)) return std::nullopt;
  return WEXITSTATUS(status);
}

}  // namespace LumenUtility
