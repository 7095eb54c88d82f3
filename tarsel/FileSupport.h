#pragma once
// Files and folders by path, and reading a file as a stream of bytes.
//
// File and Dir are plain values naming a path; they do not open anything and
// the path need not exist. Paths are kept as std::filesystem::path; the
// UTF16String forms convert through UTF-8, the encoding of file names here.
#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <memory>
#include <string>

#include "tarsel/UTFString.h"

namespace tarsel::filesupport {

class Dir;

class File {
 public:
  File() = default;
  explicit File(std::filesystem::path inPath) : mPath(std::move(inPath)) {}
  explicit File(const UTF16String& inPath);

  // True for an existing file that is not a folder (a link counts by its target).
  bool Exists() const;
  // True when the file exists and this process may not write it.
  bool IsReadOnly() const;
  // The folder that holds the file.
  Dir Parent() const;
  const std::filesystem::path& GetPath() const { return mPath; }
  // The absolute path, made lexically normal ("a/./b/../c" is "a/c").
  UTF16String GetFullPath() const;
  UTF16String GetName() const;

 private:
  std::filesystem::path mPath;
};

class Dir {
 public:
  Dir() = default;
  explicit Dir(std::filesystem::path inPath) : mPath(std::move(inPath)) {}
  explicit Dir(const UTF16String& inPath);

  // The folder of the running program, the place of its package files.
  static Dir PackageDir();

  bool Exists() const;
  // Creates the folder and any missing parents; answers whether it exists
  // afterwards.
  bool Create() const;
  // Deletes the folder with everything in it; answers whether it is gone.
  bool Delete() const;
  Dir Parent() const;
  File GetFile(const UTF16String& inName) const;
  Dir GetSubDir(const UTF16String& inName) const;
  const std::filesystem::path& GetPath() const { return mPath; }
  UTF16String GetFullPath() const;

 private:
  std::filesystem::path mPath;
};

// When inFile is a symbolic link, the file it finally leads to; otherwise
// inFile itself. A link that leads nowhere resolves to inFile too.
File ResolveIfAliasFileOnly(const File& inFile);

// Random access to the bytes of a source.
class IPlatformByteStream {
 public:
  virtual ~IPlatformByteStream() = default;
  virtual std::uint64_t Length() const = 0;
  // Reads up to inCount bytes at inOffset; answers how many were read, fewer
  // only at the end of the source.
  virtual std::size_t ReadBlock(std::uint64_t inOffset, void* outBuffer, std::size_t inCount) = 0;
};

// A byte stream over an open file; the file stays open for its lifetime.
// Opening raises the toolkit's exception when the file cannot be read.
std::unique_ptr<IPlatformByteStream> OpenFileByteStream(const File& inFile);

}  // namespace tarsel::filesupport
