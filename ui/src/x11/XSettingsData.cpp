#include "ui/src/x11/XSettingsData.h"

#include "tarsel/ThrowError.h"

namespace norvik::ui::x11 {

namespace {

constexpr std::string_view kMalformedKey =
    "$$$/norvik/ui/Error/XSettingsMalformed=The desktop settings are malformed at byte ^0.";

enum : std::uint8_t { kLSBFirst = 0, kMSBFirst = 1 };
enum : std::uint8_t { kTypeInteger = 0, kTypeString = 1, kTypeColor = 2 };

// A cursor over the property bytes in the daemon's byte order. Every read
// checks the length first, so a short or lying record stops at its offset.
class Cursor {
 public:
  Cursor(const std::uint8_t* inData, std::size_t inSize) : mData(inData), mSize(inSize) {
    Need(1);
    if (mData[0] != kLSBFirst && mData[0] != kMSBFirst) Fail();
    mBigEndian = mData[0] == kMSBFirst;
  }

  std::uint32_t Read(std::size_t inBytes) {
    Need(inBytes);
    std::uint32_t value = 0;
    for (std::size_t i = 0; i < inBytes; ++i) {
      const std::size_t byte = mBigEndian ? i : inBytes - 1 - i;
      value = (value << 8) | mData[mAt + byte];
    }
    mAt += inBytes;
    return value;
  }
  std::string ReadText(std::size_t inLength) {
    Need(Padded(inLength));
    std::string text(reinterpret_cast<const char*>(mData + mAt), inLength);
    mAt += Padded(inLength);
    return text;
  }
  void Skip(std::size_t inBytes) {
    Need(inBytes);
    mAt += inBytes;
  }
  [[noreturn]] void Fail() const {
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError, kMalformedKey, 0, 0, false,
                               static_cast<unsigned long>(mAt));
  }

 private:
  static std::size_t Padded(std::size_t inLength) { return (inLength + 3) & ~std::size_t(3); }
  void Need(std::size_t inBytes) const {
    if (inBytes > mSize - mAt) Fail();
  }

  const std::uint8_t* mData;
  std::size_t mSize;
  std::size_t mAt = 0;
  bool mBigEndian = false;
};

}  // namespace

XSettingsData XSettingsData::Parse(const std::uint8_t* inData, std::size_t inSize) {
  Cursor cursor(inData, inSize);
  cursor.Skip(4);  // byte order and three unused bytes
  XSettingsData data;
  data.mSerial = cursor.Read(4);
  const std::uint32_t count = cursor.Read(4);
  // Each record takes at least 12 bytes, so a count the data cannot hold is
  // refused by the reads below long before it could cost anything.
  for (std::uint32_t i = 0; i < count; ++i) {
    const std::uint32_t type = cursor.Read(1);
    cursor.Skip(1);
    std::string name = cursor.ReadText(cursor.Read(2));
    if (name.empty()) cursor.Fail();
    cursor.Skip(4);  // the serial of the setting's last change
    Value value;
    if (type == kTypeInteger) {
      value = static_cast<std::int32_t>(cursor.Read(4));
    } else if (type == kTypeString) {
      value = cursor.ReadText(cursor.Read(4));
    } else if (type == kTypeColor) {
      Color color{};
      for (std::uint16_t& channel : color) channel = static_cast<std::uint16_t>(cursor.Read(2));
      value = color;
    } else {
      cursor.Fail();
    }
    data.mValues.insert_or_assign(std::move(name), std::move(value));
  }
  return data;
}

std::optional<std::int32_t> XSettingsData::FindInteger(const std::string& inName) const {
  auto it = mValues.find(inName);
  if (it == mValues.end() || !std::holds_alternative<std::int32_t>(it->second)) return std::nullopt;
  return std::get<std::int32_t>(it->second);
}

std::optional<std::string> XSettingsData::FindString(const std::string& inName) const {
  auto it = mValues.find(inName);
  if (it == mValues.end() || !std::holds_alternative<std::string>(it->second)) return std::nullopt;
  return std::get<std::string>(it->second);
}

}  // namespace norvik::ui::x11
