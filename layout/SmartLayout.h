#pragma once
// One-shot composition for dialog-like content. A layout answers two
// questions only: how big it is to begin with (GetInitialSize) and where it
// goes (SetLocation). Wrappers around an inner layout each add one rule; the
// extra space a wrapper is given is handed on by a small strategy rather than
// solved for.
//
// Sizes, margins and spacings that come in as NaN, infinite or negative count
// as 0, so a bad number never travels down the chain into a node.
#include <boost/function.hpp>
#include <boost/intrusive_ptr.hpp>

#include "tarsel/PointT.h"
#include "tarsel/RectT.h"
#include "tarsel/RefCountedObject.h"

namespace norvik::layout {

using PointF = tarsel::geom::PointT<float>;
using RectF = tarsel::geom::RectT<float>;

// inValue when it is a finite number of at least 0, else 0.
float SanitizeExtent(float inValue);
PointF SanitizeSize(const PointF& inSize);
// A finite origin (NaN and infinities become 0) and sanitized extents.
RectF SanitizeRect(const RectF& inRect);

class SmartLayout : public tarsel::utility::RefCountedObject {
 public:
  SmartLayout() = default;
  explicit SmartLayout(const PointF& inInitialSize) : mInitialSize(SanitizeSize(inInitialSize)) {}
  ~SmartLayout() override = default;

  virtual void SetLocation(const RectF& inRect) = 0;
  virtual PointF GetInitialSize() { return mInitialSize; }

 protected:
  void SetInitialSizeField(const PointF& inSize) { mInitialSize = SanitizeSize(inSize); }

 private:
  PointF mInitialSize;
};

using SmartLayoutP = boost::intrusive_ptr<SmartLayout>;

// Takes no room and places nothing: the core that a builder starts from.
class EmptyLayout : public SmartLayout {
 public:
  void SetLocation(const RectF&) override {}
  PointF GetInitialSize() override { return PointF(0, 0); }
  static SmartLayoutP GetSharedPtr();
};

class LayoutDecorator : public SmartLayout {
 public:
  explicit LayoutDecorator(SmartLayoutP inDecorated = nullptr);

  void SetLocation(const RectF& inRect) override;
  PointF GetInitialSize() override;

  virtual SmartLayoutP GetDecoratedObject() const { return mDecorated; }
  // A null layout stands for the empty one, so the chain never ends in null.
  virtual void SetDecoratedObject(SmartLayoutP inDecorated);
  // Puts inDecorator between this object and its inner layout.
  virtual void InsertLayoutDecorator(boost::intrusive_ptr<LayoutDecorator> inDecorator);

 private:
  SmartLayoutP mDecorated;
};

using LayoutDecoratorP = boost::intrusive_ptr<LayoutDecorator>;

// Tells a listener where the layout is going before passing the rectangle on.
class LayoutNotifier : public LayoutDecorator {
 public:
  using Function = boost::function<void(const RectF&)>;
  explicit LayoutNotifier(Function inFunction, SmartLayoutP inDecorated = nullptr)
      : LayoutDecorator(std::move(inDecorated)), mFunction(std::move(inFunction)) {}

  void SetLocation(const RectF& inRect) override;

 private:
  Function mFunction;
};

// The child's coordinates are relative to the parent's rectangle: a node
// layout inside a panel whose own layout places the panel.
class ParentChildLayoutJoiner : public SmartLayout {
 public:
  ParentChildLayoutJoiner(SmartLayoutP inParent, SmartLayoutP inChild);

  void SetLocation(const RectF& inRect) override;
  PointF GetInitialSize() override;

 private:
  SmartLayoutP mParent;
  SmartLayoutP mChild;
};

}  // namespace norvik::layout
