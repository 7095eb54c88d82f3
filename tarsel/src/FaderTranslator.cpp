#include "tarsel/FaderTranslator.h"

#include "tarsel/ThrowError.h"

namespace tarsel::utility {

namespace fader_detail {

void ThrowBadLaw() {
  config::ThrowError(config::ErrorLevel::kError,
                     "$$$/tarsel/utility/Error/Fader/BadLaw=A fader law needs a finite maximum of at least "
                     "0 dB and a finite curve above 0.",
                     config::kErrorGroupContract, config::kErrorCodeContract);
}

void ThrowNotANumber() {
  config::ThrowError(config::ErrorLevel::kError,
                     "$$$/tarsel/utility/Error/Fader/NotANumber=A fader value is not a number.",
                     config::kErrorGroupContract, config::kErrorCodeContract);
}

}  // namespace fader_detail

template class FaderTranslator<double>;
template class FaderTranslator<float>;

}  // namespace tarsel::utility
