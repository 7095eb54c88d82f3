#pragma once
// Debug keys: named switches and values that a developer flips at run time
// (from the console's panel, or from code under test) to change how parts of
// the toolkit behave while debugging. Each entry holds one typed value; the
// console shows an editor fitting its type. Safe to use from any thread.
#include <mutex>
#include <map>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "tarsel/UTFString.h"

namespace tarsel::debug {

// The value of a debug key; std::monostate means "no such key".
using DebugEntry = std::variant<std::monostate, bool, long long, double, std::string>;

class DebugDatabase {
 public:
  static DebugDatabase& Instance();

  // Every key, sorted.
  std::vector<UTF8String> GetDebugKeys() const;
  // The entry of a key, or std::monostate when there is none.
  DebugEntry GetEntry(std::string_view inKey) const;
  bool HasEntry(std::string_view inKey) const;
  // Sets (or with std::monostate, removes) an entry.
  void SetEntry(std::string_view inKey, DebugEntry inValue);

  // Typed reads with a fallback for a missing key or an entry of another
  // type. Numbers read as either numeric type.
  bool GetBool(std::string_view inKey, bool inDefault) const;
  long long GetInteger(std::string_view inKey, long long inDefault) const;
  double GetDouble(std::string_view inKey, double inDefault) const;
  std::string GetString(std::string_view inKey, std::string_view inDefault) const;

  void Clear();

 private:
  DebugDatabase() = default;
  mutable std::mutex mMutex;
  std::map<std::string, DebugEntry, std::less<>> mEntries;
};

}  // namespace tarsel::debug
