#include "lumenutil/output_file.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <csignal>
#include <cstring>
#include <fstream>
#include <stdexcept>

namespace lumenutil {
namespace {

// The temporary file being written, for the signal handler: a fixed buffer, since the
// handler may only make async-signal-safe calls. One output file is written at a time.
char g_temporaryPath[4096];
volatile std::sig_atomic_t g_haveTemporary = 0;

// SIGXFSZ stops a process whose file outgrows its size limit (ulimit -f) in mid-write.
constexpr int kStopSignals[] = {SIGINT, SIGTERM, SIGHUP, SIGXFSZ};
constexpr int kStopSignalCount = sizeof kStopSignals / sizeof kStopSignals[0];
// The handling each signal had before; one that was ignored (SIGHUP under nohup, SIGXFSZ
// turned into an EFBIG write error) stays ignored.
void (*g_previousHandlers[kStopSignalCount])(int);

void CatchStopSignals(void (*handler)(int)) {
  for (int i = 0; i < kStopSignalCount; ++i) {
    g_previousHandlers[i] = std::signal(kStopSignals[i], handler);
    if (g_previousHandlers[i] == SIG_IGN) std::signal(kStopSignals[i], SIG_IGN);
  }
}

void RestoreStopSignals() {
  for (int i = 0; i < kStopSignalCount; ++i) std::signal(kStopSignals[i], g_previousHandlers[i]);
}

extern "C" void RemoveTemporaryAndStop(int signal) {
  if (g_haveTemporary) ::unlink(g_temporaryPath);
  std::signal(signal, SIG_DFL);
  std::raise(signal);
}

std::string Reason(int error) {
  return std::strerror(error);
}

// Holds the temporary file for one write; removes it unless Commit succeeded.
class TemporaryFile {
 public:
  explicit TemporaryFile(const std::string& target) : m_target(target) {
    const std::size_t slash = target.rfind('/');
    const std::string directory = slash == std::string::npos ? "" : target.substr(0, slash + 1);
    const std::string name = slash == std::string::npos ? target : target.substr(slash + 1);
    m_path = directory + "." + name + ".XXXXXX";
    if (m_path.size() >= sizeof g_temporaryPath) {
      throw std::runtime_error(target + ": cannot be written: the path is too long");
    }
    CatchStopSignals(RemoveTemporaryAndStop);
    std::memcpy(g_temporaryPath, m_path.c_str(), m_path.size() + 1);
    m_fd = ::mkstemp(g_temporaryPath);
    if (m_fd < 0) {
      const int error = errno;
      Release();
      throw std::runtime_error(target + ": cannot be written: " + Reason(error));
    }
    m_path = g_temporaryPath;
    g_haveTemporary = 1;
  }
  TemporaryFile(const TemporaryFile&) = delete;
  TemporaryFile& operator=(const TemporaryFile&) = delete;
  ~TemporaryFile() {
    if (m_fd >= 0) ::close(m_fd);
    if (!m_committed) ::unlink(m_path.c_str());
    Release();
  }

  const std::string& Path() const { return m_path; }

  // Gives the file the target's mode, puts it on disk and renames it over the target.
  void Commit() {
    struct stat existing {};
    mode_t mode = 0;
    if (::stat(m_target.c_str(), &existing) == 0) {
      mode = existing.st_mode & 07777;
    } else {
      const mode_t mask = ::umask(0);
      ::umask(mask);
      mode = 0666 & ~mask;
    }
    if (::fchmod(m_fd, mode) != 0 || ::fsync(m_fd) != 0) Fail();
    if (::close(m_fd) != 0) {
      m_fd = -1;
      Fail();
    }
    m_fd = -1;
    if (::rename(m_path.c_str(), m_target.c_str()) != 0) Fail();
    m_committed = true;
  }

 private:
  [[noreturn]] void Fail() const {
    throw std::runtime_error(m_target + ": writing failed: " + Reason(errno));
  }
  static void Release() {
    g_haveTemporary = 0;
    RestoreStopSignals();
  }

  std::string m_target;
  std::string m_path;
  int m_fd = -1;
  bool m_committed = false;
};

bool WrittenInPlace(const std::string& path) {
  struct stat info {};
  return ::stat(path.c_str(), &info) == 0 && !S_ISREG(info.st_mode);
}

}  // namespace

void WriteOutputFile(const std::string& path, const std::function<void(std::ostream&)>& write) {
  if (WrittenInPlace(path)) {
    std::ofstream out(path, std::ios::binary);
    if (!out) throw std::runtime_error(path + ": cannot be written: " + Reason(errno));
    write(out);
    if (!out.flush()) throw std::runtime_error(path + ": writing failed: " + Reason(errno));
    return;
  }
  TemporaryFile temporary(path);
  {
    std::ofstream out(temporary.Path(), std::ios::binary | std::ios::trunc);
    if (!out) throw std::runtime_error(path + ": cannot be written: " + Reason(errno));
    write(out);
    errno = 0;
    out.close();
    if (!out) throw std::runtime_error(path + ": writing failed: " + Reason(errno));
  }
  temporary.Commit();
}

bool WriteOutputFileAt(const std::string& path,
                       const std::function<bool(const std::string& file)>& write) {
  if (WrittenInPlace(path)) return write(path);
  TemporaryFile temporary(path);
  if (!write(temporary.Path())) return false;
  temporary.Commit();
  return true;
}

void RefuseOutputOverInput(const std::string& output, const std::string& input) {
  struct stat out {};
  struct stat in {};
  if (::stat(output.c_str(), &out) != 0 || ::stat(input.c_str(), &in) != 0) return;
  if (out.st_dev == in.st_dev && out.st_ino == in.st_ino && S_ISREG(out.st_mode)) {
    throw std::runtime_error(output + ": is the input file; choose another output");
  }
}

}  // namespace lumenutil
