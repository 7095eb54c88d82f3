#pragma once
// The settings a desktop's settings daemon publishes in the _XSETTINGS_SETTINGS
// property of its selection owner: integers, strings and colours by name.
// The bytes come from another X client, so every length and count is checked
// against the data before it is used; malformed data raises the toolkit's
// error and nothing of it is kept.
#include <array>
#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <variant>

namespace norvik::ui::x11 {

class XSettingsData {
 public:
  using Color = std::array<std::uint16_t, 4>;  // red, green, blue, alpha
  using Value = std::variant<std::int32_t, std::string, Color>;

  // Reads a whole property value. Raises "XSettingsMalformed" with the offset
  // of the first byte that cannot be read.
  static XSettingsData Parse(const std::uint8_t* inData, std::size_t inSize);

  std::uint32_t GetSerial() const { return mSerial; }
  std::size_t GetCount() const { return mValues.size(); }
  std::optional<std::int32_t> FindInteger(const std::string& inName) const;
  std::optional<std::string> FindString(const std::string& inName) const;

 private:
  std::uint32_t mSerial = 0;
  std::map<std::string, Value> mValues;
};

}  // namespace norvik::ui::x11
