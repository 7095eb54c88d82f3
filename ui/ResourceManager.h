#pragma once
// The seam to the named resources carried in the library (PNG images, XML
// documents). The resource work implements it; the manager holds one.
#include <string>
#include <vector>

namespace norvik::ui {

class ResourceManager {
 public:
  virtual ~ResourceManager() = default;

  // The bytes of the resource of this name and type; false when there is none.
  virtual bool GetResource(const std::string& inName, const std::string& inType,
                           std::vector<unsigned char>& outBytes) const = 0;
};

}  // namespace norvik::ui
