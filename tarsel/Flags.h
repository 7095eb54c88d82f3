#pragma once
// A typed bit set: Flags<unsigned char> carries modifier keys,
// Flags<unsigned long> state flags, Flags<unsigned short> number-format flags.

namespace tarsel::utility {

template <typename T>
class Flags {
 public:
  constexpr Flags() = default;
  constexpr Flags(T inBits) : mBits(inBits) {}  // NOLINT: implicit from raw bits by design

  constexpr T Get() const { return mBits; }
  constexpr bool Test(T inBits) const { return (mBits & inBits) == inBits && inBits != 0; }
  constexpr bool TestAny(T inBits) const { return (mBits & inBits) != 0; }
  constexpr bool IsEmpty() const { return mBits == 0; }
  Flags& Set(T inBits) { mBits = static_cast<T>(mBits | inBits); return *this; }
  Flags& Set(T inBits, bool inOn) { return inOn ? Set(inBits) : Clear(inBits); }
  Flags& Clear(T inBits) { mBits = static_cast<T>(mBits & ~inBits); return *this; }
  Flags& ClearAll() { mBits = 0; return *this; }

  constexpr Flags operator|(Flags o) const { return Flags(static_cast<T>(mBits | o.mBits)); }
  constexpr Flags operator&(Flags o) const { return Flags(static_cast<T>(mBits & o.mBits)); }
  Flags& operator|=(Flags o) { mBits = static_cast<T>(mBits | o.mBits); return *this; }
  Flags& operator&=(Flags o) { mBits = static_cast<T>(mBits & o.mBits); return *this; }
  constexpr bool operator==(Flags o) const { return mBits == o.mBits; }
  constexpr bool operator!=(Flags o) const { return mBits != o.mBits; }

 private:
  T mBits{0};
};

}  // namespace tarsel::utility
