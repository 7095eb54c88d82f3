#pragma once
// Data carried inside a module's own file: the PNG and XML resources that the
// build compiles into the library, found by name and type ("CursorID-26",
// "PNG"). Names and types compare without regard to ASCII case.
//
// A module is named by a handle from dlopen; kThisModule (null) is the module
// that holds the toolkit. Another module carries resources when it was built
// with the same embedding step, which exports the same table.
#include <cstddef>
#include <string_view>
#include <vector>

namespace tarsel::resources {

using ModuleHandle = void*;
constexpr ModuleHandle kThisModule = nullptr;

// Copies the resource into outBuffer (replacing its content); answers false,
// leaving outBuffer alone, when the module has no such resource.
bool GetBinaryFromModule(ModuleHandle inModule, std::string_view inName, std::string_view inType,
                         std::vector<unsigned char>& outBuffer);
bool ModuleHasBinary(ModuleHandle inModule, std::string_view inName, std::string_view inType);

// The address of an exported function of the module, or null. For
// kThisModule every loaded module is searched in load order.
void* GetFunctionPointerFromModuleImpl(ModuleHandle inModule, const char* inName);

template <typename F>
F GetFunctionPointerFromModule(ModuleHandle inModule, const char* inName) {
  return reinterpret_cast<F>(GetFunctionPointerFromModuleImpl(inModule, inName));
}

}  // namespace tarsel::resources
