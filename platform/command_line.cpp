#include "platform/command_line.h"

namespace LumenUtility {

std::vector<std::wstring> SplitCommandLine(std::wstring_view commandLine) {
  std::vector<std::wstring> arguments;
  std::wstring current;
  bool inArgument = false;  // an empty quoted part ("") still makes an argument
  bool quoted = false;
  std::size_t i = 0;
  const std::size_t n = commandLine.size();
  while (i < n) {
    const wchar_t c = commandLine[i];
    if ((c == L' ' || c == L'\t') && !quoted) {
      if (inArgument) arguments.push_back(std::move(current));
      current.clear();
      inArgument = false;
      ++i;
      continue;
    }
    inArgument = true;
    if (c == L'\\') {
      std::size_t run = 0;
      while (i < n && commandLine[i] == L'\\') {
        ++run;
        ++i;
      }
      if (i < n && commandLine[i] == L'"') {
        current.append(run / 2, L'\\');
        if (run % 2 == 1) {
          current += L'"';
          ++i;
        }
        // An even run leaves the quote to the next round, where it opens or closes.
      } else {
        current.append(run, L'\\');
      }
      continue;
    }
    if (c == L'"') {
      if (quoted && i + 1 < n && commandLine[i + 1] == L'"') {
        current += L'"';
        i += 2;
        continue;
      }
      quoted = !quoted;
      ++i;
      continue;
    }
    current += c;
    ++i;
  }
  if (inArgument) arguments.push_back(std::move(current));
  return arguments;
}

}  // namespace LumenUtility
