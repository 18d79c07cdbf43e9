#include <sys/stat.h>

#include <iostream>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "lumen/platform/text_conversion.h"
#include "lumen/util/zlib_util.h"
#include "lumenutil/commands.h"
#include "lumenutil/output_file.h"

namespace lumenutil {
namespace {

using LumenUtility::Utf8ToWide;
using LumenUtility::WideToUtf8;

struct ZipOptions {
  std::string archive;
  std::string directory;
  std::vector<std::string> files;
};

// Names the first input that cannot be packed, so the error says which one.
void CheckInputs(const ZipOptions& options) {
  for (const std::string& file : options.files) {
    if (file.empty() || file.front() == '/')
      throw std::runtime_error(
          "'" + file + "': name the file relative to " +
          (options.directory.empty() ? "the current directory (or -C DIR)" : options.directory));
    const std::string path = options.directory.empty() ? file : options.directory + "/" + file;
    struct stat info {};
    if (::stat(path.c_str(), &info) != 0) throw std::runtime_error(path + ": no such file");
    if (!S_ISREG(info.st_mode)) throw std::runtime_error(path + ": not a regular file");
  }
}

void Zip(const ZipOptions& options) {
  CheckInputs(options);
  std::vector<std::wstring> files;
  for (const std::string& file : options.files) files.push_back(Utf8ToWide(file));
  const bool written = WriteOutputFileAt(options.archive, [&](const std::string& path) {
    return LumenUtility::ZlibUtil::DoZip(Utf8ToWide(options.directory), files, Utf8ToWide(path));
  });
  if (!written) {
    throw std::runtime_error(options.archive +
                             ": not written: an input climbs out of its directory, could not "
                             "be read, or is 4 GiB or more");
  }
}

void Unzip(const std::string& archive, const std::string& directory) {
  std::vector<std::wstring> extracted;
  const bool ok =
      LumenUtility::ZlibUtil::DoUnzip(Utf8ToWide(archive), Utf8ToWide(directory), &extracted);
  for (const std::wstring& name : extracted) std::cout << WideToUtf8(name) << '\n';
  if (!ok) {
    throw std::runtime_error(archive + ": extraction stopped after " +
                             std::to_string(extracted.size()) +
                             " entries: the archive is damaged, uses a method other than "
                             "stored or deflate, or names a path outside " +
                             directory);
  }
}

}  // namespace

void AddZipCommands(CLI::App& app) {
  auto zip = std::make_shared<ZipOptions>();
  CLI::App* pack = app.add_subcommand("zip", "Pack files into a new ZIP archive (deflate)");
  pack->add_option("OUT", zip->archive, "the archive to write (replaced when it exists)")
      ->required();
  pack->add_option("-C,--directory", zip->directory,
                   "the directory the files are named relative to (default: the current one)");
  pack->add_option("FILES", zip->files, "files to pack, relative to the directory")->required();
  pack->callback([zip] { Zip(*zip); });

  auto archive = std::make_shared<std::string>();
  auto directory = std::make_shared<std::string>();
  CLI::App* unpack = app.add_subcommand(
      "unzip", "Extract a ZIP archive, printing the path of each entry extracted");
  unpack->add_option("IN", *archive, "the archive to read")->required()->check(CLI::ExistingFile);
  unpack->add_option("-d,--directory", *directory, "the directory to extract into (created)")
      ->required();
  unpack->callback([archive, directory] { Unzip(*archive, *directory); });
}

}  // namespace lumenutil
