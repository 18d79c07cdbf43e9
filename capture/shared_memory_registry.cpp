#include "capture/shared_memory_registry.h"

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <map>
#include <mutex>

#include "lumen/platform/text_conversion.h"

namespace LumenUtility {

namespace {

struct CreatedName {
  int holders;
  pid_t creator;
};

std::mutex& TableMutex() {
  static std::mutex mutex;
  return mutex;
}

std::map<std::string, CreatedName>& Table() {
  static std::map<std::string, CreatedName> table;
  return table;
}

[[noreturn]] void ThrowOsError(int error) {
  throw HResultFromOsError(error);
}

int OpenObject(const std::string& name, int flags) {
  int fd;
  do {
    fd = shm_open(name.c_str(), flags, S_IRUSR | S_IWUSR);
  } while (fd < 0 && errno == EINTR);
  return fd;
}

// Gives a new object its size. Pages are reserved as well: a block larger than the memory
// left to the shared-memory file system would otherwise end the writer with SIGBUS at the
// first page that cannot be supplied, instead of failing here.
int SizeNewObject(int fd, std::int64_t size) {
  if (ftruncate(fd, size) != 0) return errno;
  const int reserved = posix_fallocate(fd, 0, size);
  return reserved == EOPNOTSUPP || reserved == EINVAL ? 0 : reserved;
}

// The object must hold at least `size` bytes: a view is never mapped past its end.
int CheckExistingSize(int fd, std::int64_t size) {
  struct stat status {};
  if (fstat(fd, &status) != 0) return errno;
  return status.st_size < size ? EEXIST : 0;
}

}  // namespace

std::string SharedMemoryRegistry::ObjectName(const std::wstring& blockName) {
  if (blockName.empty() || blockName.find_first_of(std::wstring(L"/\0", 2)) != std::wstring::npos) {
    ThrowOsError(EINVAL);
  }
  return "/" + WideToUtf8(blockName);
}

int SharedMemoryRegistry::Open(const std::string& objectName, std::int64_t size, bool& holder) {
  holder = false;
  std::lock_guard<std::mutex> lock(TableMutex());
  auto& table = Table();
  const auto created = table.find(objectName);
  const bool ours = created != table.end() && created->second.creator == getpid();

  int fd = OpenObject(objectName, O_RDWR | O_CREAT | O_EXCL);
  const bool isNew = fd >= 0;
  if (!isNew) {
    if (errno != EEXIST) ThrowOsError(errno);
    fd = OpenObject(objectName, O_RDWR);
    if (fd < 0) ThrowOsError(errno);
  }
  const int error = isNew ? SizeNewObject(fd, size) : CheckExistingSize(fd, size);
  if (error != 0) {
    close(fd);
    if (isNew) shm_unlink(objectName.c_str());
    ThrowOsError(error);
  }
  if (ours && !isNew) {
    ++created->second.holders;
    holder = true;
  } else if (isNew) {
    // A name this process created before and someone else removed is created afresh.
    table[objectName] = CreatedName{ours ? created->second.holders + 1 : 1, getpid()};
    holder = true;
  }
  return fd;
}

void SharedMemoryRegistry::AddHolder(const std::string& objectName) {
  std::lock_guard<std::mutex> lock(TableMutex());
  const auto created = Table().find(objectName);
  if (created != Table().end()) ++created->second.holders;
}

void SharedMemoryRegistry::Release(const std::string& objectName) {
  std::lock_guard<std::mutex> lock(TableMutex());
  auto& table = Table();
  const auto created = table.find(objectName);
  if (created == table.end() || --created->second.holders > 0) return;
  if (created->second.creator == getpid()) shm_unlink(objectName.c_str());
  table.erase(created);
}

bool SharedMemoryRegistry::IsHeld(const std::string& objectName) {
  std::lock_guard<std::mutex> lock(TableMutex());
  const auto created = Table().find(objectName);
  return created != Table().end() && created->second.creator == getpid();
}

}  // namespace LumenUtility
