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

// What the choice rule reads of one candidate at one size, each measure
// taken once: a walk over many candidates then measures each of them once.
struct Merit {
  bool fits;
  float loss;  // the wasted area when it fits, else the overflowing area
  float area;
  float golden;
};

static Merit MeritOf(IArrangement& inArrangement, PointF const& inSize) {
  Merit merit{Fits(inArrangement, inSize), 0.0f, 0.0f, 0.0f};
  if (!merit.fits) {
    merit.loss = inArrangement.OverflowArea(inSize);
    return merit;
  }
  merit.loss = inArrangement.WastedArea(inSize);
  merit.area = inArrangement.MinWidth() * inArrangement.MinHeight();
  merit.golden = GoldenDistance(inArrangement);
  return merit;
}

// Of two candidates that overflow, only the overflow counts; a tie keeps the best.
static bool Better(Merit const& inChallenger, Merit const& inBest) {
  if (inChallenger.fits != inBest.fits) return inChallenger.fits;
  if (inChallenger.loss != inBest.loss) return inChallenger.loss < inBest.loss;
  if (!inChallenger.fits) return false;
  if (inChallenger.area != inBest.area) return inChallenger.area < inBest.area;
  return inChallenger.golden < inBest.golden;
}

bool Beats(IArrangement& inChallenger, IArrangement& inBest, PointF const& inSize) {
  return Better(MeritOf(inChallenger, inSize), MeritOf(inBest, inSize));
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
  Merit bestMerit = MeritOf(*best, inSize);
  for (auto it = begin() + 1; it != end(); ++it) {
    (*it)->Prepare();
    const Merit merit = MeritOf(**it, inSize);
    if (!Better(merit, bestMerit)) continue;
    best = it->get();
    bestMerit = merit;
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
