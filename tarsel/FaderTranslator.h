#pragma once
// The fader law: how a fader's normalised position (0 at the bottom, 1 at the
// top) maps to a gain in decibels, and back. Rulers and meters that show a
// decibel scale beside a fader use the same translator, so that their marks
// line up with the fader.
//
// The law is a power law on the linear gain: position = (gain / max gain) to
// the power 1 / curve, where gain = 10^(dB / 20). In decibels:
//
//   dB(p) = 20 * curve * log10(p / z)      with z = 10^(-max / (20 * curve))
//   p(dB) = z * 10^(dB / (20 * curve))
//
// z is the zero position, where the fader reads 0 dB. The ends are exact:
// position 0 is minus infinity (silence) and position 1 is the maximum;
// 0 dB maps exactly to z and z exactly to 0 dB. Both directions are
// monotonic, and positions and decibels outside the range are clamped to it.
// The defaults (a maximum of +6 dB, curve 4) put 0 dB at about 84% of the
// travel, -20 dB at about 47% and -60 dB at about 15%: fine control near
// unity gain, the long quiet tail compressed at the bottom.
#include <cmath>
#include <limits>

#include "tarsel/RefCountedObject.h"

namespace tarsel::utility {

namespace fader_detail {
[[noreturn]] void ThrowBadLaw();
[[noreturn]] void ThrowNotANumber();
}  // namespace fader_detail

template <typename T>
class FaderTranslator : public RefCountedObject {
 public:
  // The maximum must be finite and at least 0 dB, the curve finite and above
  // 0; otherwise the toolkit's exception is raised.
  explicit FaderTranslator(T inMaximumDecibels = T(6), T inCurve = T(4))
      : mMaximumDecibels(inMaximumDecibels), mCurve(inCurve) {
    if (!std::isfinite(inMaximumDecibels) || inMaximumDecibels < T(0) || !std::isfinite(inCurve) ||
        inCurve <= T(0))
      fader_detail::ThrowBadLaw();
    mScale = T(20) * mCurve;
    mZeroPosition = std::pow(T(10), -mMaximumDecibels / mScale);
  }

  // Decibels at a normalised position; minus infinity at 0 and below. A NaN
  // position raises the toolkit's exception.
  T GetDecibelValue(T inNormalized) const {
    if (std::isnan(inNormalized)) fader_detail::ThrowNotANumber();
    if (inNormalized <= T(0)) return -std::numeric_limits<T>::infinity();
    if (inNormalized >= T(1)) return mMaximumDecibels;
    // Dividing by z first makes z itself give log10(1), exactly 0.
    const T decibels = mScale * std::log10(inNormalized / mZeroPosition);
    return decibels < mMaximumDecibels ? decibels : mMaximumDecibels;
  }

  // Normalised position of a decibel value; 0 for minus infinity, 1 at and
  // above the maximum. A NaN raises the toolkit's exception.
  T GetNormalizedValue(T inDecibels) const {
    if (std::isnan(inDecibels)) fader_detail::ThrowNotANumber();
    if (inDecibels >= mMaximumDecibels) return T(1);
    if (inDecibels == -std::numeric_limits<T>::infinity()) return T(0);
    const T position = mZeroPosition * std::pow(T(10), inDecibels / mScale);
    return position < T(1) ? position : T(1);
  }

  T GetZeroPosition() const { return mZeroPosition; }
  T GetMaximumDecibels() const { return mMaximumDecibels; }
  T GetCurve() const { return mCurve; }

 private:
  T mMaximumDecibels;
  T mCurve;
  T mScale;
  T mZeroPosition;
};

extern template class FaderTranslator<double>;
extern template class FaderTranslator<float>;

}  // namespace tarsel::utility
