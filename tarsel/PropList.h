#pragma once
// A property list: a keyed tree of typed values, the in-memory form of every
// prop-list document (archives, preferences, scripts, cursor data).
//
// Keys are UTF8String and are kept in byte order (unsigned bytes, as memcmp
// orders them), which is also the order in which documents are written.
//
// A PropList is a value: copying one copies the whole tree. Sub-lists are
// nevertheless held by boost::intrusive_ptr, so that a caller that took a
// sub-list with GetSubList may keep it after its parent was cleared or the key
// erased. Nothing in the interface can insert an existing list into another,
// so a tree can never contain itself.
//
// Typed access is strict: GetValue(key, int32) answers false when the key holds
// an unsigned integer or a float. GetValueType tells what a key holds.
#include <cstdint>
#include <map>
#include <string_view>
#include <variant>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include "tarsel/RefCountedObject.h"
#include "tarsel/UTFString.h"

namespace tarsel::proplist {

class PropList;
void intrusive_ptr_add_ref(const PropList* inList) noexcept;
void intrusive_ptr_release(const PropList* inList) noexcept;

using PropListP = boost::intrusive_ptr<PropList>;
using ConstPropListP = boost::intrusive_ptr<const PropList>;

enum class ValueType {
  kNone,  // the key does not exist
  kBool,
  kInt32,
  kUInt32,
  kFloat,
  kDouble,
  kString,   // UTF8String, an 8-bit value
  kUString,  // UTF16String
  kList,     // a sub-list
  kInt32Array,
  kUInt32Array,
  kFloatArray,
  kDoubleArray,
  kStringArray,
  kUStringArray,
};

// One value of a property list. Copying a value that holds a sub-list copies
// the sub-list.
class PropValue {
 public:
  using Storage = std::variant<bool, std::int32_t, std::uint32_t, float, double, UTF8String, UTF16String, PropListP,
                               std::vector<std::int32_t>, std::vector<std::uint32_t>, std::vector<float>,
                               std::vector<double>, std::vector<UTF8String>, std::vector<UTF16String>>;

  PropValue() = default;
  template <typename T, typename = std::enable_if_t<!std::is_same_v<std::decay_t<T>, PropValue>>>
  explicit PropValue(T&& inValue) : mStorage(std::forward<T>(inValue)) {}
  PropValue(const PropValue& inOther);
  PropValue(PropValue&& inOther) noexcept = default;
  PropValue& operator=(const PropValue& inOther);
  PropValue& operator=(PropValue&& inOther) noexcept = default;
  ~PropValue() = default;

  ValueType GetType() const;
  const Storage& GetStorage() const { return mStorage; }
  Storage& GetStorage() { return mStorage; }

  // The held value when it has type T, else null.
  template <typename T>
  const T* GetIf() const { return std::get_if<T>(&mStorage); }
  template <typename T>
  T* GetIf() { return std::get_if<T>(&mStorage); }

  // Deep comparison: sub-lists compare by content.
  bool operator==(const PropValue& inOther) const;
  bool operator!=(const PropValue& inOther) const { return !(*this == inOther); }

 private:
  Storage mStorage{false};
};

class PropList : public utility::RefCountedObject {
 public:
  struct KeyLess {
    using is_transparent = void;
    bool operator()(std::string_view a, std::string_view b) const { return a < b; }
  };
  using Entries = std::map<UTF8String, PropValue, KeyLess>;
  using const_iterator = Entries::const_iterator;

  PropList() = default;
  PropList(const PropList& inOther);
  PropList& operator=(const PropList& inOther);
  PropList(PropList&& inOther) noexcept;
  PropList& operator=(PropList&& inOther) noexcept;
  ~PropList() override;

  // Each answers true and fills outValue only when the key exists with exactly
  // that type; otherwise outValue is left as it was.
  bool GetValue(std::string_view inKey, bool& outValue) const;
  bool GetValue(std::string_view inKey, std::int32_t& outValue) const;
  bool GetValue(std::string_view inKey, std::uint32_t& outValue) const;
  bool GetValue(std::string_view inKey, float& outValue) const;
  bool GetValue(std::string_view inKey, double& outValue) const;
  bool GetValue(std::string_view inKey, UTF8String& outValue) const;
  bool GetValue(std::string_view inKey, UTF16String& outValue) const;
  bool GetValue(std::string_view inKey, std::vector<std::int32_t>& outValue) const;
  bool GetValue(std::string_view inKey, std::vector<std::uint32_t>& outValue) const;
  bool GetValue(std::string_view inKey, std::vector<float>& outValue) const;
  bool GetValue(std::string_view inKey, std::vector<double>& outValue) const;
  bool GetValue(std::string_view inKey, std::vector<UTF8String>& outValue) const;
  bool GetValue(std::string_view inKey, std::vector<UTF16String>& outValue) const;

  // Each replaces whatever the key held, whatever its type.
  void SetValue(std::string_view inKey, bool inValue);
  void SetValue(std::string_view inKey, std::int32_t inValue);
  void SetValue(std::string_view inKey, std::uint32_t inValue);
  void SetValue(std::string_view inKey, float inValue);
  void SetValue(std::string_view inKey, double inValue);
  void SetValue(std::string_view inKey, const UTF8String& inValue);
  void SetValue(std::string_view inKey, const UTF16String& inValue);
  // Literals: without these a string literal would convert to bool.
  void SetValue(std::string_view inKey, const char* inValue);
  void SetValue(std::string_view inKey, const char16_t* inValue);
  // Any other 8-bit text (std::string, std::string_view) as a UTF8String.
  void SetValue(std::string_view inKey, std::string_view inValue);
  void SetValue(std::string_view inKey, std::vector<std::int32_t> inValue);
  void SetValue(std::string_view inKey, std::vector<std::uint32_t> inValue);
  void SetValue(std::string_view inKey, std::vector<float> inValue);
  void SetValue(std::string_view inKey, std::vector<double> inValue);
  void SetValue(std::string_view inKey, std::vector<UTF8String> inValue);
  void SetValue(std::string_view inKey, std::vector<UTF16String> inValue);
  void SetPropValue(std::string_view inKey, PropValue inValue);

  // The sub-list under the key; null when the key is missing or holds no list.
  PropListP GetSubList(std::string_view inKey);
  ConstPropListP GetSubList(std::string_view inKey) const;
  // A new empty sub-list under the key, replacing what the key held.
  PropListP NewSubList(std::string_view inKey);
  // Stores a copy of inList under the key.
  void SetSubList(std::string_view inKey, const PropList& inList);

  bool HasKey(std::string_view inKey) const;
  ValueType GetValueType(std::string_view inKey) const;
  const PropValue* FindValue(std::string_view inKey) const;
  // Removes the key; answers whether it existed.
  bool Erase(std::string_view inKey);
  void Clear();
  std::size_t Size() const { return mEntries.size(); }
  bool IsEmpty() const { return mEntries.empty(); }

  // Entries in key order.
  const_iterator begin() const { return mEntries.begin(); }
  const_iterator end() const { return mEntries.end(); }

  // Deep comparison of keys, types and values.
  bool operator==(const PropList& inOther) const;
  bool operator!=(const PropList& inOther) const { return !(*this == inOther); }

 private:
  template <typename T>
  bool GetTyped(std::string_view inKey, T& outValue) const;
  void Put(std::string_view inKey, PropValue&& inValue);

  Entries mEntries;
};

}  // namespace tarsel::proplist
