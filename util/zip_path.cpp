#include "util/zip_path.h"

#include <vector>

namespace LumenUtility {

std::optional<std::string> NormalizeRelativePath(std::string_view path) {
  if (path.empty() || path.front() == '/' || path.find('\0') != std::string_view::npos)
    return std::nullopt;
  std::vector<std::string_view> components;
  std::size_t start = 0;
  while (start <= path.size()) {
    std::size_t end = path.find('/', start);
    if (end == std::string_view::npos) end = path.size();
    const std::string_view component = path.substr(start, end - start);
    if (component == "..") {
      if (components.empty()) return std::nullopt;
      components.pop_back();
    } else if (!component.empty() && component != ".") {
      components.push_back(component);
    }
    start = end + 1;
  }
  if (components.empty()) return std::nullopt;
  std::string result;
  for (const std::string_view component : components) {
    if (!result.empty()) result += '/';
    result += component;
  }
  return result;
}

std::optional<std::string> ExtractionPath(std::string_view name, bool& isDirectory) {
  std::string path(name);
  for (char& c : path) {
    if (c == '\\') c = '/';
  }
  isDirectory = !path.empty() && path.back() == '/';
  const bool drive = path.size() >= 2 && path[1] == ':' &&
                     ((path[0] >= 'A' && path[0] <= 'Z') || (path[0] >= 'a' && path[0] <= 'z'));
  if (drive) return std::nullopt;
  return NormalizeRelativePath(path);
}

}  // namespace LumenUtility
