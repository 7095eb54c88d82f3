#pragma once
// The message of the toolkit's exception that a call raises, or "no error".
#include <string>

#include "tarsel/ThrowError.h"

namespace norvik::test {

template <typename F>
std::string ErrorOf(F&& inCall) {
  try {
    inCall();
  } catch (tarsel::config::Exception const& e) {
    return e.what();
  }
  return "no error";
}

}  // namespace norvik::test
