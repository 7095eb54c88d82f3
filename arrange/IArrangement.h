#pragma once
// A computed way of placing one element at a size, and the set of candidates
// from which an element picks.
//
// Dominance. A candidate A dominates a candidate B when A measures exactly as
// B does at every size: same kind of arrangement, same element, same group
// level, and children that dominate each other pairwise (a leaf: the same
// leaf with the same sizes, margins and expandability). The choice at a size
// keeps the earlier of two candidates of equal merit, so a dominated newcomer
// can never be picked and is dropped; the set keeps one representative. A
// looser rule (comparing minimum sizes only, say) would be wrong: a candidate
// that needs more room may still waste less of a large rectangle.
#include <cstdint>
#include <unordered_map>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include "arrange/ArrangeTypes.h"
#include "tarsel/RefCountedObject.h"

namespace norvik::arrange::impl {

class IArrangement : public tarsel::utility::RefCountedObject {
 public:
  ~IArrangement() override = default;
  virtual PointF Arrange(RectF const& inRect) = 0;
  virtual bool HorizontallyExpandable() const = 0;
  virtual bool VerticallyExpandable() const = 0;
  virtual float MinWidth() const = 0;
  virtual float MinHeight() const = 0;
  virtual float NaturalWidth() const = 0;
  virtual float NaturalHeight() const = 0;
  virtual float ExpandedWidth(float inWidth) const = 0;
  virtual float ExpandedHeight(float inHeight) const = 0;
  virtual float OverflowArea(PointF const& inSize) const;
  virtual float WastedArea(PointF const& inSize) const;
  virtual void Prepare() {}
  virtual bool IsGroupLevel() const = 0;
  // See the paragraph on dominance above.
  virtual bool Dominates(IArrangement const& inOther) const = 0;
  // Equal for any two candidates of which one dominates the other, so that
  // the set compares only candidates that share it.
  virtual std::uint64_t Signature() const { return 0; }
};

using ArrangementPtr = boost::intrusive_ptr<IArrangement>;

class ArrangementSet : public std::vector<ArrangementPtr> {
 public:
  // Adds a candidate unless a member already has its merit; a null pointer is
  // ignored. Returns whether the candidate was kept. Only members with the
  // candidate's signature are compared.
  bool AddArrangement(ArrangementPtr inArrangement);
  void clear();

  // The candidate the choice rule picks for a size; null for an empty set.
  IArrangement* ChooseFor(PointF const& inSize) const;
  // The candidate nearest the golden ratio in natural size, the first on a tie.
  IArrangement* MostBalanced() const;

 private:
  void Reindex();

  std::unordered_multimap<std::uint64_t, ArrangementPtr> mBySignature;
  std::size_t mIndexed = 0;
};

// True when the challenger beats the current best at a size. Ties keep the best.
bool Beats(IArrangement& inChallenger, IArrangement& inBest, PointF const& inSize);

}  // namespace norvik::arrange::impl
