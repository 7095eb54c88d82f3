#include <algorithm>
#include <cmath>
#include <cstring>
#include <limits>

#include "arrange/IArrangement.h"

namespace norvik::arrange::impl {

namespace {

constexpr float kGoldenRatio = 1.618034f;

float GoldenDistance(IArrangement& inArrangement) {
  const float height = inArrangement.NaturalHeight();
  if (!(height > 0.0f)) return std::numeric_limits<float>::infinity();
  return std::fabs(inArrangement.NaturalWidth() / height - kGoldenRatio);
}

bool Fits(IArrangement& inArrangement, PointF const& inSize) {
  return inArrangement.MinWidth() <= inSize.x && inArrangement.MinHeight() <= inSize.y;
}

}  // namespace

float IArrangement::OverflowArea(PointF const& inSize) const {
  const float dw = std::max(0.0f, MinWidth() - inSize.x);
  const float dh = std::max(0.0f, MinHeight() - inSize.y);
  return MinWidth() * dh + MinHeight() * dw;
}

float IArrangement::WastedArea(PointF const& inSize) const {
  return inSize.x * inSize.y - ExpandedWidth(inSize.x) * ExpandedHeight(inSize.y);
}

bool Beats(IArrangement& inChallenger, IArrangement& inBest, PointF const& inSize) {
  const bool challengerFits = Fits(inChallenger, inSize);
  if (challengerFits != Fits(inBest, inSize)) return challengerFits;
  if (!challengerFits) return inChallenger.OverflowArea(inSize) < inBest.OverflowArea(inSize);
  const float challengerWaste = inChallenger.WastedArea(inSize);
  const float bestWaste = inBest.WastedArea(inSize);
  if (challengerWaste != bestWaste) return challengerWaste < bestWaste;
  const float challengerArea = inChallenger.MinWidth() * inChallenger.MinHeight();
  const float bestArea = inBest.MinWidth() * inBest.MinHeight();
  if (challengerArea != bestArea) return challengerArea < bestArea;
  return GoldenDistance(inChallenger) < GoldenDistance(inBest);
}

void ArrangementSet::clear() {
  std::vector<ArrangementPtr>::clear();
  mBySignature.clear();
  mIndexed = 0;
}

void ArrangementSet::Reindex() {
  mBySignature.clear();
  for (const ArrangementPtr& member : *this) mBySignature.emplace(member->Signature(), member);
  mIndexed = size();
}

bool ArrangementSet::AddArrangement(ArrangementPtr inArrangement) {
  if (!inArrangement) return false;
  if (mIndexed != size()) Reindex();  // members were added past this function
  const std::uint64_t key = inArrangement->Signature();
  auto [first, last] = mBySignature.equal_range(key);
  bool removed = false;
  for (auto it = first; it != last; ++it) {
    if (it->second->Dominates(*inArrangement)) return false;
    removed = removed || inArrangement->Dominates(*it->second);
  }
  if (removed) {
    erase(std::remove_if(begin(), end(),
                         [&](const ArrangementPtr& inMember) { return inArrangement->Dominates(*inMember); }),
          end());
    Reindex();
  }
  mBySignature.emplace(key, inArrangement);
  push_back(std::move(inArrangement));
  mIndexed = size();
  return true;
}

IArrangement* ArrangementSet::ChooseFor(PointF const& inSize) const {
  if (empty()) return nullptr;
  IArrangement* best = front().get();
  best->Prepare();
  for (auto it = begin() + 1; it != end(); ++it) {
    (*it)->Prepare();
    if (Beats(**it, *best, inSize)) best = it->get();
  }
  return best;
}

IArrangement* ArrangementSet::MostBalanced() const {
  IArrangement* best = nullptr;
  float bestDistance = 0.0f;
  for (const ArrangementPtr& candidate : *this) {
    candidate->Prepare();
    const float distance = GoldenDistance(*candidate);
    if (!best || distance < bestDistance) {
      best = candidate.get();
      bestDistance = distance;
    }
  }
  return best;
}

}  // namespace norvik::arrange::impl
