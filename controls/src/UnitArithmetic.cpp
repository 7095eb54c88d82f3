// The four operations between typed operands and their units. A percentage
// added is a change (100 + 10% is 110), multiplied a share; two lengths may
// be added but not multiplied.
#include "controls/UnitHandlerRegistry.h"

namespace norvik::controls {

namespace {

enum class Operation { kAdd, kSubtract, kMultiply, kDivide };

double Apply(Operation inOp, double a, double b) {
  switch (inOp) {
    case Operation::kAdd: return a + b;
    case Operation::kSubtract: return a - b;
    case Operation::kMultiply: return a * b;
    case Operation::kDivide: return a / b;
  }
  return a;
}

// The percentage p applied to the value v of another unit.
bool ApplyPercent(Operation inOp, double p, double v, bool inPercentFirst, double& outResult) {
  const double share = p / 100;
  switch (inOp) {
    case Operation::kAdd: outResult = (share + 1) * v; return true;
    case Operation::kSubtract: outResult = inPercentFirst ? (share - 1) * v : (1 - share) * v; return true;
    case Operation::kMultiply: outResult = share * v; return true;
    case Operation::kDivide:
      if (inPercentFirst) return false;
      outResult = v / share;
      return true;
  }
  return false;
}

bool Arithmetic(const UnitHandlerRegistry& inRegistry, Operation inOp, double a, double b, NumberEditUnit inA,
                NumberEditUnit inB, NumberEditUnit inTarget, double& outResult, NumberEditUnit& outUnit) {
  const auto plain = [&](NumberEditUnit inUnit) {
    outResult = Apply(inOp, a, b);
    outUnit = inUnit;
    return true;
  };
  const bool additive = inOp == Operation::kAdd || inOp == Operation::kSubtract;
  if (inOp == Operation::kDivide && b == 0) return false;
  if (inTarget == kNumberEditUnit_NoUnit || inTarget == kNumberEditUnit_Degree) return plain(inTarget);
  const bool percentA = inA == kNumberEditUnit_Percent, percentB = inB == kNumberEditUnit_Percent;
  if (percentA && percentB) return additive && plain(kNumberEditUnit_Percent);
  if (inTarget == kNumberEditUnit_Percent) {
    if (percentA && additive) {
      outUnit = inB;
      return ApplyPercent(inOp, a, b, true, outResult);
    }
    return plain(kNumberEditUnit_Percent);
  }
  if (percentB) {
    outUnit = inA;
    return ApplyPercent(inOp, b, a, false, outResult);
  }
  if (percentA) {
    outUnit = inB;
    return ApplyPercent(inOp, a, b, true, outResult);
  }
  // Lengths. Two bare numbers stay bare, to take the field's unit.
  if (inA == kNumberEditUnit_NoUnit && inB == kNumberEditUnit_NoUnit) return plain(kNumberEditUnit_NoUnit);
  const auto toBase = [&inRegistry](NumberEditUnit inUnit, double inValue) {
    const UnitHandlerP handler = inRegistry.GetUnitHandler(inUnit);
    return handler ? handler->ToBaseUnit(inValue) : inValue;
  };
  if (additive) {
    const NumberEditUnit unitA = inA == kNumberEditUnit_NoUnit ? inB : inA;
    const NumberEditUnit unitB = inB == kNumberEditUnit_NoUnit ? inA : inB;
    outResult = Apply(inOp, toBase(unitA, a), toBase(unitB, b));
    outUnit = kNumberEditUnit_Point;
    return true;
  }
  if (inA != kNumberEditUnit_NoUnit && inB != kNumberEditUnit_NoUnit) return false;
  // A length divided by a length would be a bare ratio; by a plain number the
  // bare form is the only meaning left.
  if (inOp == Operation::kDivide && inA == kNumberEditUnit_NoUnit) return plain(kNumberEditUnit_NoUnit);
  outResult = toBase(inA == kNumberEditUnit_NoUnit ? inB : inA, Apply(inOp, a, b));
  outUnit = kNumberEditUnit_Point;
  return true;
}

}  // namespace

bool UnitHandlerRegistry::AddNumbers(double a, double b, NumberEditUnit inUnitA, NumberEditUnit inUnitB,
                                     NumberEditUnit inTarget, double& outResult, NumberEditUnit& outUnit) const {
  return Arithmetic(*this, Operation::kAdd, a, b, inUnitA, inUnitB, inTarget, outResult, outUnit);
}

bool UnitHandlerRegistry::SubtractNumbers(double a, double b, NumberEditUnit inUnitA, NumberEditUnit inUnitB,
                                          NumberEditUnit inTarget, double& outResult, NumberEditUnit& outUnit) const {
  return Arithmetic(*this, Operation::kSubtract, a, b, inUnitA, inUnitB, inTarget, outResult, outUnit);
}

bool UnitHandlerRegistry::MultiplyNumbers(double a, double b, NumberEditUnit inUnitA, NumberEditUnit inUnitB,
                                          NumberEditUnit inTarget, double& outResult, NumberEditUnit& outUnit) const {
  return Arithmetic(*this, Operation::kMultiply, a, b, inUnitA, inUnitB, inTarget, outResult, outUnit);
}

bool UnitHandlerRegistry::DivideNumbers(double a, double b, NumberEditUnit inUnitA, NumberEditUnit inUnitB,
                                        NumberEditUnit inTarget, double& outResult, NumberEditUnit& outUnit) const {
  return Arithmetic(*this, Operation::kDivide, a, b, inUnitA, inUnitB, inTarget, outResult, outUnit);
}

}  // namespace norvik::controls
