#include "arrange/LineDistribution.h"

#include <algorithm>
#include <cmath>

namespace norvik::arrange::impl {

namespace {

// One pass over the expanding children; returns the change of the total of
// the extents that still take part.
void SharePass(std::vector<ArrangementPtr> const& inChildren, LineAxis inAxis, LineResult& ioResult,
               float& ioExtra, float& ioExpandableTotal) {
  float passTotal = ioExpandableTotal;
  for (std::size_t i = 0; i < inChildren.size(); ++i) {
    LineRecord& record = ioResult.records[i];
    if (!record.expands) continue;
    if (!(passTotal > 0.0f)) break;
    const IArrangement& child = *inChildren[i];
    const float old = record.main;
    const float target = old * ((passTotal + ioExtra) / passTotal);
    const float grown = std::max(inAxis.MinMain(child), SaneExtent(inAxis.ExpandedMain(child, target)));
    if (grown == target)
      ioExpandableTotal += grown - old;
    else
      ioExpandableTotal -= old;
    ioExtra -= grown - old;
    record.main = grown;
    passTotal -= old;
  }
}

}  // namespace

LineResult DistributeLine(std::vector<ArrangementPtr> const& inChildren, LineAxis inAxis, float inMain,
                          float inCross, float inExtra) {
  LineResult result;
  result.records.resize(inChildren.size());
  float expandableTotal = 0.0f;
  for (std::size_t i = 0; i < inChildren.size(); ++i) {
    const IArrangement& child = *inChildren[i];
    LineRecord& record = result.records[i];
    record.cross = SaneExtent(inAxis.ExpandedCross(child, inCross));
    record.main = inAxis.NaturalMain(child);
    record.expands = inAxis.ExpandsMain(child);
    result.usedCross = std::max(result.usedCross, record.cross);
    if (record.expands) expandableTotal += record.main;
  }
  float extra = inExtra;
  while (std::fabs(extra) >= kDistributionEpsilon && expandableTotal > 0.0f &&
         result.passes < kMaxDistributionPasses) {
    ++result.passes;
    SharePass(inChildren, inAxis, result, extra, expandableTotal);
  }
  result.usedMain = inMain - extra;
  return result;
}

}  // namespace norvik::arrange::impl
