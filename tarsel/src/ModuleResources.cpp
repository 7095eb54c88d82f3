#include "tarsel/ModuleResources.h"

#include <algorithm>
#include <cstring>

#include <dlfcn.h>

namespace tarsel::resources {

// Declared exactly as the generated source of the embedded resources defines
// it.
struct EmbeddedResource {
  const char* name;
  const char* type;
  const unsigned char* data;
  std::size_t size;
};

extern const EmbeddedResource kEmbeddedResources[];
extern const std::size_t kEmbeddedResourceCount;

namespace {

bool EqualIgnoringCase(std::string_view a, const char* b) {
  if (!b || std::strlen(b) != a.size()) return false;
  return std::equal(a.begin(), a.end(), b, [](char x, char y) {
    const auto lower = [](char c) { return (c >= 'A' && c <= 'Z') ? static_cast<char>(c - 'A' + 'a') : c; };
    return lower(x) == lower(y);
  });
}

struct Table {
  const EmbeddedResource* entries = nullptr;
  std::size_t count = 0;
};

Table TableOf(ModuleHandle inModule) {
  if (inModule == kThisModule) return {kEmbeddedResources, kEmbeddedResourceCount};
  // The table's symbols as the embedding step exports them from a module.
  const auto* entries =
      static_cast<const EmbeddedResource*>(::dlsym(inModule, "_ZN6tarsel9resources18kEmbeddedResourcesE"));
  const auto* count =
      static_cast<const std::size_t*>(::dlsym(inModule, "_ZN6tarsel9resources22kEmbeddedResourceCountE"));
  if (!entries || !count) return {};
  return {entries, *count};
}

const EmbeddedResource* Find(ModuleHandle inModule, std::string_view inName, std::string_view inType) {
  const Table table = TableOf(inModule);
  for (std::size_t i = 0; i < table.count; ++i) {
    const EmbeddedResource& entry = table.entries[i];
    if (EqualIgnoringCase(inName, entry.name) && EqualIgnoringCase(inType, entry.type)) return &entry;
  }
  return nullptr;
}

}  // namespace

bool GetBinaryFromModule(ModuleHandle inModule, std::string_view inName, std::string_view inType,
                         std::vector<unsigned char>& outBuffer) {
  const EmbeddedResource* entry = Find(inModule, inName, inType);
  if (!entry) return false;
  outBuffer.assign(entry->data, entry->data + entry->size);
  return true;
}

bool ModuleHasBinary(ModuleHandle inModule, std::string_view inName, std::string_view inType) {
  return Find(inModule, inName, inType) != nullptr;
}

void* GetFunctionPointerFromModuleImpl(ModuleHandle inModule, const char* inName) {
  if (!inName) return nullptr;
  return ::dlsym(inModule == kThisModule ? RTLD_DEFAULT : inModule, inName);
}

}  // namespace tarsel::resources
