#include "arrange/WrappingArrangeableGroup.h"

#include <map>

namespace norvik::arrange::impl {

namespace {

using Lines = std::map<std::pair<std::size_t, std::size_t>, ArrangementPtr>;

ArrangementPtr MakeGroup(AbstractArrangeableGroup& inGroup, LineAxis inAxis,
                         std::vector<ArrangementPtr> const& inChildren, std::vector<ISeparator*> const& inSeparators,
                         bool inGroupLevel) {
  if (inAxis.vertical) return new ColumnArrangement(inGroup, inChildren, inSeparators, inGroupLevel);
  return new RowArrangement(inGroup, inChildren, inSeparators, inGroupLevel);
}

class CutBuilder {
 public:
  CutBuilder(AbstractArrangeableGroup& inGroup, std::vector<ArrangementPtr> const& inChildren, LineAxis inLineAxis)
      : mGroup(inGroup), mChildren(inChildren), mLineAxis(inLineAxis) {
    const std::vector<ISeparator*>& separators = inGroup.Separators();
    mSeparators.assign(separators.begin(), separators.end());
    mSeparators.resize(inChildren.size() - 1, nullptr);
  }

  // Adds the stack for the cut that starts a new line after each listed child.
  void AddCut(std::vector<std::size_t> const& inBreaks) {
    std::vector<ArrangementPtr> lines;
    std::vector<ISeparator*> between;
    std::size_t begin = 0;
    for (std::size_t i = 0; i <= inBreaks.size(); ++i) {
      const std::size_t end = i < inBreaks.size() ? inBreaks[i] + 1 : mChildren.size();
      lines.push_back(Line(begin, end));
      if (i < inBreaks.size()) between.push_back(mSeparators[inBreaks[i]]);
      begin = end;
    }
    mGroup.ArrangementsSelf().AddArrangement(MakeGroup(mGroup, LineAxis{!mLineAxis.vertical}, lines, between, true));
  }

 private:
  ArrangementPtr Line(std::size_t inBegin, std::size_t inEnd) {
    ArrangementPtr& line = mLines[{inBegin, inEnd}];
    if (!line) {
      std::vector<ArrangementPtr> children(mChildren.begin() + inBegin, mChildren.begin() + inEnd);
      std::vector<ISeparator*> separators(mSeparators.begin() + inBegin, mSeparators.begin() + (inEnd - 1));
      line = MakeGroup(mGroup, mLineAxis, children, separators, false);
    }
    return line;
  }

  AbstractArrangeableGroup& mGroup;
  std::vector<ArrangementPtr> const& mChildren;
  LineAxis mLineAxis;
  std::vector<ISeparator*> mSeparators;
  Lines mLines;
};

// Steps the k - 1 break positions among the n - 1 gaps to the next
// combination in lexicographic order; false after the last.
bool NextBreaks(std::vector<std::size_t>& ioBreaks, std::size_t inGaps) {
  std::size_t k = ioBreaks.size();
  while (k > 0) {
    --k;
    if (ioBreaks[k] < inGaps - (ioBreaks.size() - k)) {
      ++ioBreaks[k];
      for (std::size_t j = k + 1; j < ioBreaks.size(); ++j) ioBreaks[j] = ioBreaks[j - 1] + 1;
      return true;
    }
  }
  return false;
}

}  // namespace

void AddWrappingCandidates(AbstractArrangeableGroup& inGroup, std::vector<ArrangementPtr> const& inChildren,
                           LineAxis inLineAxis) {
  if (inChildren.empty()) return;
  CutBuilder builder(inGroup, inChildren, inLineAxis);
  const std::size_t gaps = inChildren.size() - 1;
  std::size_t cuts = 0;
  for (std::size_t lineCount = 1; lineCount <= inChildren.size(); ++lineCount) {
    std::vector<std::size_t> breaks(lineCount - 1);
    for (std::size_t i = 0; i < breaks.size(); ++i) breaks[i] = i;
    do {
      if (cuts++ == kMaxWrappingCuts) return;
      // Mirrored, so that among cuts of equal merit the one that fills the
      // first lines comes first and wins the tie.
      std::vector<std::size_t> mirrored(breaks.rbegin(), breaks.rend());
      for (std::size_t& gap : mirrored) gap = gaps - 1 - gap;
      builder.AddCut(mirrored);
    } while (!breaks.empty() && NextBreaks(breaks, gaps));
  }
}

}  // namespace norvik::arrange::impl
