#include "tarsel/DebugDatabase.h"

namespace tarsel::debug {

DebugDatabase& DebugDatabase::Instance() {
  static DebugDatabase* database = new DebugDatabase;  // outlives static destruction
  return *database;
}

std::vector<UTF8String> DebugDatabase::GetDebugKeys() const {
  std::lock_guard<std::mutex> lock(mMutex);
  std::vector<UTF8String> keys;
  keys.reserve(mEntries.size());
  for (const auto& entry : mEntries) keys.emplace_back(entry.first.data(), entry.first.size());
  return keys;
}

DebugEntry DebugDatabase::GetEntry(std::string_view inKey) const {
  std::lock_guard<std::mutex> lock(mMutex);
  auto it = mEntries.find(inKey);
  return it == mEntries.end() ? DebugEntry() : it->second;
}

bool DebugDatabase::HasEntry(std::string_view inKey) const {
  std::lock_guard<std::mutex> lock(mMutex);
  return mEntries.find(inKey) != mEntries.end();
}

void DebugDatabase::SetEntry(std::string_view inKey, DebugEntry inValue) {
  std::lock_guard<std::mutex> lock(mMutex);
  auto it = mEntries.find(inKey);
  if (std::holds_alternative<std::monostate>(inValue)) {
    if (it != mEntries.end()) mEntries.erase(it);
  } else if (it == mEntries.end()) {
    mEntries.emplace(std::string(inKey), std::move(inValue));
  } else {
    it->second = std::move(inValue);
  }
}

bool DebugDatabase::GetBool(std::string_view inKey, bool inDefault) const {
  DebugEntry entry = GetEntry(inKey);
  const bool* value = std::get_if<bool>(&entry);
  return value ? *value : inDefault;
}

long long DebugDatabase::GetInteger(std::string_view inKey, long long inDefault) const {
  DebugEntry entry = GetEntry(inKey);
  if (const long long* value = std::get_if<long long>(&entry)) return *value;
  if (const double* value = std::get_if<double>(&entry)) {
    // Out-of-range doubles (and NaN) cannot become an integer: fall back.
    if (*value >= -9.2e18 && *value <= 9.2e18) return static_cast<long long>(*value);
  }
  return inDefault;
}

double DebugDatabase::GetDouble(std::string_view inKey, double inDefault) const {
  DebugEntry entry = GetEntry(inKey);
  if (const double* value = std::get_if<double>(&entry)) return *value;
  if (const long long* value = std::get_if<long long>(&entry)) return static_cast<double>(*value);
  return inDefault;
}

std::string DebugDatabase::GetString(std::string_view inKey, std::string_view inDefault) const {
  DebugEntry entry = GetEntry(inKey);
  const std::string* value = std::get_if<std::string>(&entry);
  return value ? *value : std::string(inDefault);
}

void DebugDatabase::Clear() {
  std::lock_guard<std::mutex> lock(mMutex);
  mEntries.clear();
}

}  // namespace tarsel::debug
