#include "tarsel/PropList.h"

namespace tarsel::proplist {

void intrusive_ptr_add_ref(const PropList* inList) noexcept { inList->AddRef(); }
void intrusive_ptr_release(const PropList* inList) noexcept { inList->Release(); }

namespace {

PropValue::Storage CopyStorage(const PropValue::Storage& inStorage) {
  if (const auto* list = std::get_if<PropListP>(&inStorage)) {
    return PropListP(*list ? new PropList(**list) : new PropList());
  }
  return inStorage;
}

}  // namespace

PropValue::PropValue(const PropValue& inOther) : mStorage(CopyStorage(inOther.mStorage)) {}

PropValue& PropValue::operator=(const PropValue& inOther) {
  if (this != &inOther) mStorage = CopyStorage(inOther.mStorage);
  return *this;
}

ValueType PropValue::GetType() const {
  // The order of ValueType after kNone follows the order of the alternatives.
  return static_cast<ValueType>(mStorage.index() + 1);
}

bool PropValue::operator==(const PropValue& inOther) const {
  if (mStorage.index() != inOther.mStorage.index()) return false;
  if (const auto* list = std::get_if<PropListP>(&mStorage)) {
    const PropListP& other = std::get<PropListP>(inOther.mStorage);
    if (!*list || !other) return !*list == !other;
    return **list == *other;
  }
  return mStorage == inOther.mStorage;
}

PropList::PropList(const PropList& inOther) : RefCountedObject(), mEntries(inOther.mEntries) {}

PropList& PropList::operator=(const PropList& inOther) {
  if (this != &inOther) {
    Entries copy(inOther.mEntries);  // copy first: inOther may live inside this tree
    mEntries.swap(copy);
  }
  return *this;
}

PropList::PropList(PropList&& inOther) noexcept : RefCountedObject(), mEntries(std::move(inOther.mEntries)) {}

PropList& PropList::operator=(PropList&& inOther) noexcept {
  if (this != &inOther) {
    Entries taken(std::move(inOther.mEntries));
    mEntries.swap(taken);
  }
  return *this;
}

PropList::~PropList() = default;

template <typename T>
bool PropList::GetTyped(std::string_view inKey, T& outValue) const {
  auto it = mEntries.find(inKey);
  if (it == mEntries.end()) return false;
  const T* value = it->second.GetIf<T>();
  if (!value) return false;
  outValue = *value;
  return true;
}

bool PropList::GetValue(std::string_view inKey, bool& outValue) const { return GetTyped(inKey, outValue); }
bool PropList::GetValue(std::string_view inKey, std::int32_t& outValue) const { return GetTyped(inKey, outValue); }
bool PropList::GetValue(std::string_view inKey, std::uint32_t& outValue) const { return GetTyped(inKey, outValue); }
bool PropList::GetValue(std::string_view inKey, float& outValue) const { return GetTyped(inKey, outValue); }
bool PropList::GetValue(std::string_view inKey, double& outValue) const { return GetTyped(inKey, outValue); }
bool PropList::GetValue(std::string_view inKey, UTF8String& outValue) const { return GetTyped(inKey, outValue); }
bool PropList::GetValue(std::string_view inKey, UTF16String& outValue) const { return GetTyped(inKey, outValue); }
bool PropList::GetValue(std::string_view inKey, std::vector<std::int32_t>& outValue) const {
  return GetTyped(inKey, outValue);
}
bool PropList::GetValue(std::string_view inKey, std::vector<std::uint32_t>& outValue) const {
  return GetTyped(inKey, outValue);
}
bool PropList::GetValue(std::string_view inKey, std::vector<float>& outValue) const {
  return GetTyped(inKey, outValue);
}
bool PropList::GetValue(std::string_view inKey, std::vector<double>& outValue) const {
  return GetTyped(inKey, outValue);
}
bool PropList::GetValue(std::string_view inKey, std::vector<UTF8String>& outValue) const {
  return GetTyped(inKey, outValue);
}
bool PropList::GetValue(std::string_view inKey, std::vector<UTF16String>& outValue) const {
  return GetTyped(inKey, outValue);
}

void PropList::Put(std::string_view inKey, PropValue&& inValue) {
  auto it = mEntries.find(inKey);
  if (it != mEntries.end()) {
    // Move the old value out before it is replaced, so that a value taken from
    // inside the old one stays valid until the assignment is complete.
    PropValue old(std::move(it->second));
    it->second = std::move(inValue);
    return;
  }
  mEntries.emplace(UTF8String(inKey.data(), inKey.size()), std::move(inValue));
}

void PropList::SetValue(std::string_view inKey, bool inValue) { Put(inKey, PropValue(inValue)); }
void PropList::SetValue(std::string_view inKey, std::int32_t inValue) { Put(inKey, PropValue(inValue)); }
void PropList::SetValue(std::string_view inKey, std::uint32_t inValue) { Put(inKey, PropValue(inValue)); }
void PropList::SetValue(std::string_view inKey, float inValue) { Put(inKey, PropValue(inValue)); }
void PropList::SetValue(std::string_view inKey, double inValue) { Put(inKey, PropValue(inValue)); }
void PropList::SetValue(std::string_view inKey, const UTF8String& inValue) { Put(inKey, PropValue(inValue)); }
void PropList::SetValue(std::string_view inKey, const UTF16String& inValue) { Put(inKey, PropValue(inValue)); }
void PropList::SetValue(std::string_view inKey, const char* inValue) {
  Put(inKey, PropValue(UTF8String(inValue ? inValue : "")));
}
void PropList::SetValue(std::string_view inKey, std::string_view inValue) {
  Put(inKey, PropValue(UTF8String(inValue.data(), inValue.size())));
}
void PropList::SetValue(std::string_view inKey, const char16_t* inValue) {
  Put(inKey, PropValue(UTF16String(inValue ? inValue : u"")));
}
void PropList::SetValue(std::string_view inKey, std::vector<std::int32_t> inValue) {
  Put(inKey, PropValue(std::move(inValue)));
}
void PropList::SetValue(std::string_view inKey, std::vector<std::uint32_t> inValue) {
  Put(inKey, PropValue(std::move(inValue)));
}
void PropList::SetValue(std::string_view inKey, std::vector<float> inValue) {
  Put(inKey, PropValue(std::move(inValue)));
}
void PropList::SetValue(std::string_view inKey, std::vector<double> inValue) {
  Put(inKey, PropValue(std::move(inValue)));
}
void PropList::SetValue(std::string_view inKey, std::vector<UTF8String> inValue) {
  Put(inKey, PropValue(std::move(inValue)));
}
void PropList::SetValue(std::string_view inKey, std::vector<UTF16String> inValue) {
  Put(inKey, PropValue(std::move(inValue)));
}
void PropList::SetPropValue(std::string_view inKey, PropValue inValue) {
  if (auto* list = inValue.GetIf<PropListP>(); list && !*list) *list = PropListP(new PropList());
  Put(inKey, std::move(inValue));
}

PropListP PropList::GetSubList(std::string_view inKey) {
  auto it = mEntries.find(inKey);
  if (it == mEntries.end()) return nullptr;
  const PropListP* list = it->second.GetIf<PropListP>();
  return list ? *list : nullptr;
}

ConstPropListP PropList::GetSubList(std::string_view inKey) const {
  return const_cast<PropList*>(this)->GetSubList(inKey);
}

PropListP PropList::NewSubList(std::string_view inKey) {
  PropListP list(new PropList());
  Put(inKey, PropValue(list));
  return list;
}

void PropList::SetSubList(std::string_view inKey, const PropList& inList) {
  PropListP copy(new PropList(inList));
  Put(inKey, PropValue(copy));
}

bool PropList::HasKey(std::string_view inKey) const { return mEntries.find(inKey) != mEntries.end(); }

ValueType PropList::GetValueType(std::string_view inKey) const {
  const PropValue* value = FindValue(inKey);
  return value ? value->GetType() : ValueType::kNone;
}

const PropValue* PropList::FindValue(std::string_view inKey) const {
  auto it = mEntries.find(inKey);
  return it == mEntries.end() ? nullptr : &it->second;
}

bool PropList::Erase(std::string_view inKey) {
  auto it = mEntries.find(inKey);
  if (it == mEntries.end()) return false;
  PropValue old(std::move(it->second));
  mEntries.erase(it);
  return true;
}

void PropList::Clear() {
  Entries old;
  old.swap(mEntries);
}

bool PropList::operator==(const PropList& inOther) const {
  if (mEntries.size() != inOther.mEntries.size()) return false;
  auto a = mEntries.begin();
  for (auto b = inOther.mEntries.begin(); b != inOther.mEntries.end(); ++a, ++b) {
    if (a->first != b->first || a->second != b->second) return false;
  }
  return true;
}

}  // namespace tarsel::proplist
