#pragma once
// The platform key numbers that keyboard events carry, named once for every
// test that types.
namespace norvik::ui::test::keys {

constexpr short kTab = 9;
constexpr short kReturn = 13;
constexpr short kShift = 16;
constexpr short kAlt = 18;
constexpr short kEscape = 27;
constexpr short kSpace = 32;
constexpr short kLeft = 37;
constexpr short kUp = 38;
constexpr short kRight = 39;
constexpr short kDown = 40;

}  // namespace norvik::ui::test::keys
