#include "ui/ApplicationIdentity.h"

#include <cctype>
#include <cerrno>
#include <cstdlib>

namespace norvik::ui {
namespace {

std::string& ClassNameSet() {
  static std::string name;
  return name;
}

}  // namespace

std::string GetApplicationInstanceName() {
  if (const char* resource = std::getenv("RESOURCE_NAME"); resource && *resource) return resource;
  const char* program = program_invocation_short_name;
  return program && *program ? program : "norvik";
}

std::string GetApplicationClassName() {
  if (!ClassNameSet().empty()) return ClassNameSet();
  std::string name = GetApplicationInstanceName();
  name[0] = static_cast<char>(std::toupper(static_cast<unsigned char>(name[0])));
  return name;
}

void SetApplicationClassName(const std::string& inClassName) { ClassNameSet() = inClassName; }

}  // namespace norvik::ui
