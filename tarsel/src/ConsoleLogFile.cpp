#include "tarsel/ConsoleLogFile.h"

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

namespace tarsel::console {

ConsoleLogFile& ConsoleLogFile::GetInstance() {
  static ConsoleLogFile* instance = new ConsoleLogFile;  // other threads may log during exit
  return *instance;
}

bool ConsoleLogFile::OpenLogFile(const UTF8String& inPath) {
  std::lock_guard<std::mutex> lock(mMutex);
  CloseLocked();
  if (inPath.empty()) return false;
  const std::string path = utility::ToStdString(inPath);
  // Truncate only once the lock is ours, so that a log in use by another
  // process is left as it is.
  int fd = ::open(path.c_str(), O_WRONLY | O_CREAT | O_CLOEXEC, 0644);
  if (fd < 0) return false;
  if (::flock(fd, LOCK_EX | LOCK_NB) != 0 || ::ftruncate(fd, 0) != 0) {
    ::close(fd);
    return false;
  }
  mFile = ::fdopen(fd, "w");
  if (!mFile) {
    ::close(fd);
    return false;
  }
  mPath = inPath;
  return true;
}

void ConsoleLogFile::CloseLogFile() {
  std::lock_guard<std::mutex> lock(mMutex);
  CloseLocked();
}

void ConsoleLogFile::CloseLocked() {
  if (mFile) std::fclose(mFile);  // closing the descriptor releases the lock
  mFile = nullptr;
  mPath.clear();
}

bool ConsoleLogFile::IsLogFileOpen() const {
  std::lock_guard<std::mutex> lock(mMutex);
  return mFile != nullptr;
}

UTF8String ConsoleLogFile::GetLogFilePath() const {
  std::lock_guard<std::mutex> lock(mMutex);
  return mPath;
}

bool ConsoleLogFile::WriteToLog(std::string_view inText, bool inEndLine) {
  std::lock_guard<std::mutex> lock(mMutex);
  if (!mFile) return false;
  bool ok = std::fwrite(inText.data(), 1, inText.size(), mFile) == inText.size();
  if (inEndLine && (inText.empty() || inText.back() != '\n')) ok = std::fputc('\n', mFile) != EOF && ok;
  return std::fflush(mFile) == 0 && ok;
}

bool ConsoleLogFile::WriteToLog(const UTF16String& inText, bool inEndLine) {
  UTF8String text = utility::UTF16to8(inText);
  return WriteToLog(std::string_view(text.data(), text.size()), inEndLine);
}

}  // namespace tarsel::console
