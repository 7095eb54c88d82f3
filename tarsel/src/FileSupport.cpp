#include "tarsel/FileSupport.h"

#include <fstream>
#include <system_error>

#include <unistd.h>

#include "tarsel/ThrowError.h"

namespace tarsel::filesupport {

namespace fs = std::filesystem;

namespace {

fs::path PathFromText(const UTF16String& inPath) {
  const UTF8String utf8 = utility::UTF16to8(inPath);
  return fs::path(std::string(utf8.data(), utf8.size()));
}

UTF16String TextFromPath(const fs::path& inPath) { return utility::UTF8to16(inPath.native()); }

UTF16String FullPathText(const fs::path& inPath) {
  std::error_code error;
  fs::path absolute = fs::absolute(inPath, error);
  if (error) absolute = inPath;
  absolute = absolute.lexically_normal();
  // "a/b/.." normalises to "a/"; a full path names the folder without the
  // trailing separator.
  if (!absolute.has_filename() && absolute.has_relative_path()) absolute = absolute.parent_path();
  return TextFromPath(absolute);
}

// The parent of a path, also for paths that end in a separator ("a/b/").
fs::path ParentPath(const fs::path& inPath) {
  fs::path path = inPath;
  if (!path.has_filename() && path.has_relative_path()) path = path.parent_path();
  return path.parent_path();
}

class FileByteStream final : public IPlatformByteStream {
 public:
  explicit FileByteStream(const fs::path& inPath) : mFile(inPath, std::ios::binary) {
    std::error_code error;
    const bool regular = fs::is_regular_file(inPath, error);
    if (!mFile || !regular) {
      config::ThrowError(config::ErrorLevel::kError,
                         "$$$/tarsel/filesupport/Error/CannotOpen=The file \"^0\" cannot be opened for reading.",
                         config::kErrorGroupResources, 2, false, inPath.native());
    }
    mLength = fs::file_size(inPath, error);
    if (error) mLength = 0;
  }

  std::uint64_t Length() const override { return mLength; }

  std::size_t ReadBlock(std::uint64_t inOffset, void* outBuffer, std::size_t inCount) override {
    if (inCount == 0 || inOffset >= mLength) return 0;
    mFile.clear();
    mFile.seekg(static_cast<std::streamoff>(inOffset));
    mFile.read(static_cast<char*>(outBuffer), static_cast<std::streamsize>(inCount));
    return static_cast<std::size_t>(mFile.gcount());
  }

 private:
  std::ifstream mFile;
  std::uint64_t mLength = 0;
};

}  // namespace

File::File(const UTF16String& inPath) : mPath(PathFromText(inPath)) {}

bool File::Exists() const {
  std::error_code error;
  return fs::exists(mPath, error) && !fs::is_directory(mPath, error);
}

bool File::IsReadOnly() const { return Exists() && ::access(mPath.c_str(), W_OK) != 0; }

Dir File::Parent() const { return Dir(ParentPath(mPath)); }

UTF16String File::GetFullPath() const { return FullPathText(mPath); }

UTF16String File::GetName() const { return TextFromPath(mPath.filename()); }

Dir::Dir(const UTF16String& inPath) : mPath(PathFromText(inPath)) {}

Dir Dir::PackageDir() {
  std::error_code error;
  const fs::path program = fs::read_symlink("/proc/self/exe", error);
  if (error) return Dir(fs::current_path(error));
  return Dir(program.parent_path());
}

bool Dir::Exists() const {
  std::error_code error;
  return fs::is_directory(mPath, error);
}

bool Dir::Create() const {
  std::error_code error;
  fs::create_directories(mPath, error);
  return Exists();
}

bool Dir::Delete() const {
  std::error_code error;
  if (!Exists()) return false;
  fs::remove_all(mPath, error);
  return !error && !Exists();
}

Dir Dir::Parent() const { return Dir(ParentPath(mPath)); }

File Dir::GetFile(const UTF16String& inName) const { return File(mPath / PathFromText(inName)); }

Dir Dir::GetSubDir(const UTF16String& inName) const { return Dir(mPath / PathFromText(inName)); }

UTF16String Dir::GetFullPath() const { return FullPathText(mPath); }

File ResolveIfAliasFileOnly(const File& inFile) {
  std::error_code error;
  if (!fs::is_symlink(inFile.GetPath(), error)) return inFile;
  const fs::path target = fs::canonical(inFile.GetPath(), error);
  return error ? inFile : File(target);
}

std::unique_ptr<IPlatformByteStream> OpenFileByteStream(const File& inFile) {
  return std::make_unique<FileByteStream>(inFile.GetPath());
}

}  // namespace tarsel::filesupport
