#pragma once
// The console's log file: when open, console output is copied into it. One
// per process; safe to use from any thread.
#include <cstdio>
#include <mutex>
#include <string>
#include <string_view>

#include "tarsel/UTFString.h"

namespace tarsel::console {

class ConsoleLogFile {
 public:
  static ConsoleLogFile& GetInstance();

  // Opens (creates or truncates) the file at a UTF-8 path, closing any log
  // already open. Answers false, with no log open, when the file cannot be
  // opened or is already in use as a log by another process.
  bool OpenLogFile(const UTF8String& inPath);
  void CloseLogFile();
  bool IsLogFileOpen() const;
  // The path of the open log, empty when none is open.
  UTF8String GetLogFilePath() const;

  // Appends text (UTF-8 or UTF-16), adding a line end when inEndLine is true
  // and the text does not already end with one. The file is flushed at each
  // call so that a crash loses nothing. Answers false when no log is open or
  // the write failed.
  bool WriteToLog(std::string_view inText, bool inEndLine);
  bool WriteToLog(const UTF16String& inText, bool inEndLine);

 private:
  ConsoleLogFile() = default;
  void CloseLocked();

  mutable std::mutex mMutex;
  std::FILE* mFile = nullptr;
  UTF8String mPath;
};

}  // namespace tarsel::console
