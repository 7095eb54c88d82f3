#pragma once
// Trace: short diagnostic texts, either plain or filed under a category.
//
// A plain DebugTrace(text) always goes out. A categorised trace goes out only
// while its category's volume is above 0; every category starts at volume 0,
// so a category is silent until someone (the console's panel, a test, the
// NORVIK_TRACE environment variable read at first use) turns it up. A category
// becomes known, and is listed by GetTraceCategories, the first time it is
// traced or its volume is set.
//
// Where the text goes: to the master trace handler when one is installed,
// otherwise to standard error. A handler may itself call DebugTrace (the
// console does, to keep standard error in step): such a nested call on the
// same thread bypasses the handler and goes to standard error, so a handler
// never recurses into itself.
//
// Every function here may be called from any thread. Handlers are called
// outside the trace lock, so a handler may trace, install or remove handlers,
// or change volumes. Neither RemoveMasterTraceHandler nor an install that
// replaces a handler returns while another thread is still inside a handler
// call, so the caller may destroy the old handler as soon as it returns; a
// handler may remove or replace itself from inside Trace.
#include <string>
#include <string_view>
#include <vector>

#include "tarsel/UTFString.h"

namespace tarsel::debug {

class TraceHandler {
 public:
  virtual ~TraceHandler() = default;
  // Receives one trace text (UTF-8, without a trailing line end). May be
  // called from any thread.
  virtual void Trace(const UTF8String& inText) = 0;
};

void DebugTrace(std::string_view inText);
void DebugTrace(const UTF16String& inText);
// Traces "category: text" when the category's volume is above 0.
void DebugTrace(std::string_view inCategory, std::string_view inText);
// Traces when the category's volume is at least inLevel (1 and up).
void DebugTrace(std::string_view inCategory, int inLevel, std::string_view inText);

// Answers whether DebugTrace(inCategory, inLevel, ...) would go out, so that a
// caller can skip building an expensive text.
bool IsTraceEnabled(std::string_view inCategory, int inLevel = 1);

// Makes inHandler the master handler and answers the one it replaces (null
// when there was none). The handler is not owned.
TraceHandler* InstallMasterTraceHandler(TraceHandler* inHandler);
// Removes the master handler, whichever it is.
void RemoveMasterTraceHandler();
// Removes inHandler if it is the master handler; answers whether it was.
bool RemoveMasterTraceHandler(TraceHandler* inHandler);
TraceHandler* GetMasterTraceHandler();

// Every known category, sorted.
std::vector<UTF8String> GetTraceCategories();
// The volume of a category; 0 for a category never set.
int GetTraceVolume(std::string_view inKey);
// Sets a category's volume (negative values count as 0) and makes it known.
void SetTraceVolume(std::string_view inKey, int inVolume);

// Reads "category=volume" items separated by commas or semicolons (a bare
// category means volume 1), as found in the NORVIK_TRACE environment
// variable. Malformed items are skipped; answers how many were applied.
int ApplyTraceVolumes(std::string_view inSettings);

}  // namespace tarsel::debug

// Categorised trace that does not build its text unless the category is on.
// The text expression may use operator+ on std::string.
#define NRK_TRACE(category, text)                                     \
  do {                                                                \
    if (::tarsel::debug::IsTraceEnabled(category))                    \
      ::tarsel::debug::DebugTrace((category), (text));                \
  } while (false)
