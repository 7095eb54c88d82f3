// Builds an arrangement tree from arbitrary bytes (group kinds, leaf sizes
// including NaN, infinite and negative values, margins, the rectangle) and
// checks that no leaf is ever placed with a NaN or infinite coordinate.
#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <vector>

#include "arrange/DynamicGroup.h"
#include "arrange/Single.h"

namespace {

using namespace norvik::arrange;

class Bytes {
 public:
  Bytes(const uint8_t* inData, size_t inSize) : mData(inData), mSize(inSize) {}
  uint8_t Byte() { return mPos < mSize ? mData[mPos++] : 0; }
  float Extent() {
    const uint8_t kind = Byte();
    if (kind == 250) return NAN;
    if (kind == 251) return INFINITY;
    if (kind == 252) return -INFINITY;
    if (kind == 253) return 3.0e38f;
    if (kind >= 240) return -static_cast<float>(kind);
    return static_cast<float>(kind) * 0.75f;
  }
  bool Done() const { return mPos >= mSize; }

 private:
  const uint8_t* mData;
  size_t mSize;
  size_t mPos = 0;
};

class Leaf : public Single {
 public:
  explicit Leaf(Bytes& inBytes)
      : w(inBytes.Extent()), h(inBytes.Extent()), minW(inBytes.Extent()), margin(inBytes.Extent()),
        flags(inBytes.Byte()) {}
  float NaturalWidth() const override { return w; }
  float NaturalHeight() const override { return h; }
  float MinWidth() const override { return flags & 4 ? minW : w; }
  bool HorizontallyExpandable() const override { return flags & 1; }
  bool VerticallyExpandable() const override { return flags & 2; }
  float LeftMargin() const override { return flags & 8 ? margin : 0; }
  float BottomMargin() const override { return flags & 16 ? margin : 0; }
  PointF Place(RectF const& inRect) override {
    for (float v : {inRect.left, inRect.top, inRect.width, inRect.height})
      if (!std::isfinite(v)) std::abort();
    return PointF(flags & 32 ? NAN : inRect.width, inRect.height);
  }
  float w, h, minW, margin;
  uint8_t flags;
};

class Group : public DefaultGroup<DynamicGroup> {
 public:
  Group(IArrangeable* inParent, GroupArrangementType inType) : DefaultGroup(inParent, inType) {}
  bool VisitChildren(boost::function<bool(IArrangeable&)> inVisitor) override {
    for (IArrangeable* child : children)
      if (!inVisitor(*child)) return false;
    return true;
  }
  void ChildDestroyed(IArrangeable& inChild) override {
    children.erase(std::remove(children.begin(), children.end(), &inChild), children.end());
  }
  std::vector<IArrangeable*> children;
};

// Leaves go first, each leaving its group; then the groups, outer first.
struct Tree {
  std::vector<std::unique_ptr<Group>> groups;
  std::vector<std::unique_ptr<Leaf>> leaves;
};

// Wrapping groups grow as 2^(n-1) candidates and products multiply them,
// so the tree stays small enough for the fuzzer to run quickly.
Group& BuildGroup(Tree& ioTree, Bytes& ioBytes, IArrangeable* inParent, int inDepth) {
  auto group = std::make_unique<Group>(inParent, static_cast<GroupArrangementType>(ioBytes.Byte() % 6));
  Group& result = *group;
  ioTree.groups.push_back(std::move(group));
  result.SetLeftMargin(ioBytes.Extent());
  result.SetTopMargin(ioBytes.Extent());
  result.SetHorizontalSpacing(ioBytes.Extent());
  result.SetVerticalSpacing(ioBytes.Extent());
  result.SetHorizontalAlignment(static_cast<AlignmentHorizontal>(ioBytes.Byte() % 3));
  const int count = ioBytes.Byte() % 5;
  for (int i = 0; i < count && !ioBytes.Done(); ++i) {
    if (inDepth < 2 && ioBytes.Byte() % 4 == 0) {
      Group& child = BuildGroup(ioTree, ioBytes, &result.Arrangeable(), inDepth + 1);
      result.children.push_back(&child.Arrangeable());
    } else {
      ioTree.leaves.push_back(std::make_unique<Leaf>(ioBytes));
      ioTree.leaves.back()->SetParent(&result.Arrangeable());
      result.children.push_back(ioTree.leaves.back().get());
    }
  }
  return result;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* inData, size_t inSize) {
  Bytes bytes(inData, inSize);
  Tree tree;
  Group& root = BuildGroup(tree, bytes, nullptr, 0);
  root.Invalidate();
  root.Arrange(RectF(bytes.Extent(), bytes.Extent(), bytes.Extent(), bytes.Extent()));
  root.BestSize();
  root.Arrange(RectF(0, 0, bytes.Extent(), bytes.Extent()));
  return 0;
}
