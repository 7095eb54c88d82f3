// The walk of UI_Draw through a tree: order, what is skipped, custom drawing,
// the root's background and nodes removed while the tree is drawn.
#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "support/ui/DrawTestNodes.h"
#include "support/ui/NodeTestSupport.h"
#include "ui/Theme.h"

namespace norvik::ui::test {
namespace {

using Strings = std::vector<std::string>;
using drawbot::ColorRGBA;

std::vector<drawbot::testing::DrawCall> PaintRects(const std::vector<drawbot::testing::DrawCall>& inCalls) {
  std::vector<drawbot::testing::DrawCall> out;
  for (const auto& c : inCalls)
    if (c.op == "PaintRect") out.push_back(c);
  return out;
}

class DrawTraversal : public ManagerTest {
 protected:
  void SetUp() override {
    Theme::Initialize(ThemeP(new Theme(379, 3)));
    root = AddPaintingView("root", 0, 0, 100, 100, 2, &log);
  }
  void TearDown() override { Theme::Terminate(); }
  void Paint() { root->UI_DispatchDrawFromRoot(nullptr, &target.drawbot, false); }

  Strings log;
  RecordingTarget target;
  PaintingViewP root;
};

TEST_F(DrawTraversal, ShownChildrenPaintDepthFirstInTheirOwnCoordinatesAndNativeOnesPaintThemselves) {
  auto a = AddPaintingView("a", 30, 40, 20, 10, 3, &log, root.get());
  AddPaintingView("a1", 5, 6, 4, 4, 4, &log, a.get());
  auto hidden = AddPaintingView("hidden", 0, 0, 50, 50, 3, &log, root.get());
  AddPaintingView("under-hidden", 0, 0, 10, 10, 3, &log, hidden.get());
  hidden->UI_Show(false);
  AddPaintingView("native", 0, 0, 10, 10, 3, &log, root.get())->nativeWindow = true;
  AddPaintingView("b", 10, 10, 50, 50, 3, &log, root.get());
  const size_t depth = target.surface->GetStateDepth();
  Paint();
  EXPECT_EQ(log, (Strings{"a", "a1", "b"}));
  EXPECT_EQ(root->draws, 0);
  auto paints = PaintRects(target.Take());
  ASSERT_EQ(paints.size(), 3u);
  EXPECT_FLOAT_EQ(paints[0].transform.tx, 30);
  EXPECT_FLOAT_EQ(paints[0].transform.ty, 40);
  EXPECT_FLOAT_EQ(paints[1].transform.tx, 35);
  EXPECT_FLOAT_EQ(paints[1].transform.ty, 46);
  EXPECT_FLOAT_EQ(paints[2].transform.tx, 10) << "the first child's transform is undone";
  EXPECT_EQ(target.surface->GetStateDepth(), depth);
}

TEST_F(DrawTraversal, AChildScaledToNothingOnEitherAxisIsNotVisited) {
  auto flatX = AddPaintingView("flat-x", 0, 0, 50, 50, 3, &log, root.get());
  AddPaintingView("under-flat-x", 0, 0, 10, 10, 3, &log, flatX.get());
  auto flatY = AddPaintingView("flat-y", 0, 0, 50, 50, 3, &log, root.get());
  auto tiny = AddPaintingView("tiny", 0, 0, 50, 50, 3, &log, root.get());
  flatX->UI_SetMatrix(UI_Node::Matrix(0, 1, 0, 0));
  flatY->UI_SetMatrix(UI_Node::Matrix(1, -1e-7f, 0, 0));
  tiny->UI_SetMatrix(UI_Node::Matrix(1e-5f, 1e-5f, 0, 0));
  Paint();
  EXPECT_EQ(log, (Strings{"tiny"}));
}

TEST_F(DrawTraversal, AChildOutsideTheClipIsSkippedBeforeItsSubtreeIsVisited) {
  target.surface->SetClipRects({tarsel::geom::RectT<long>(0, 0, 40, 40)});
  auto inside = AddPaintingView("inside", 10, 10, 10, 10, 3, &log, root.get());
  auto outside = AddPaintingView("outside", 60, 60, 30, 30, 3, &log, root.get());
  AddPaintingView("under-outside", 0, 0, 5, 5, 3, &log, outside.get());
  auto straddling = AddPaintingView("straddling", 39, 0, 20, 20, 3, &log, root.get());
  AddPaintingView("half-in", 39.5f, 39.5f, 5, 5, 3, &log, root.get());
  AddPaintingView("scaled-in", 19, 19, 5, 5, 3, &log, root.get())->UI_SetMatrix(UI_Node::Matrix(2, 2, 0, 0));
  AddPaintingView("scaled-out", 20, 20, 5, 5, 3, &log, root.get())->UI_SetMatrix(UI_Node::Matrix(2, 2, 0, 0));
  Paint();
  EXPECT_EQ(log, (Strings{"inside", "straddling", "half-in", "scaled-in"}));
}

TEST_F(DrawTraversal, ASmallClipOverAWidePanelAsksTheSurfaceAboutNearbyChildrenOnly) {
  for (int i = 0; i < 400; ++i)
    AddPaintingView("cell", static_cast<float>(i % 20) * 5, static_cast<float>(i / 20) * 5, 4, 4, 3, &log, root.get());
  target.surface->SetClipRects({tarsel::geom::RectT<long>(50, 50, 4, 4)});
  Paint();
  EXPECT_EQ(log.size(), 1u);
  EXPECT_LE(target.surface->mClipProbes, 10);
}

TEST_F(DrawTraversal, ARootOutsideTheClipDrawsNothing) {
  target.surface->SetClipRects({tarsel::geom::RectT<long>(150, 150, 10, 10)});
  AddPaintingView("a", 0, 0, 10, 10, 3, &log, root.get());
  ColorRGBA background(1, 0, 0, 1);
  root->UI_DispatchDrawFromRoot(&background, &target.drawbot, false);
  EXPECT_TRUE(log.empty());
  EXPECT_EQ(RecordingTarget::Count(target.Take(), "PaintRect"), 0);
}

TEST_F(DrawTraversal, TheRootBackgroundIsPaintedFirstWithAntiAliasingUnlessTransparent) {
  AddPaintingView("a", 0, 0, 10, 10, 3, &log, root.get());
  ColorRGBA background(0.5f, 0.25f, 0, 1);
  root->UI_DispatchDrawFromRoot(&background, &target.drawbot, false);
  auto calls = target.Take();
  ASSERT_GE(calls.size(), 2u);
  EXPECT_EQ(calls[0].op, "PaintRect");
  EXPECT_EQ(calls[0].color, background);
  EXPECT_EQ(calls[0].antiAlias, drawbot::kAntiAlias);
  EXPECT_EQ(calls[0].rect, tarsel::geom::RectT<float>(0, 0, 100, 100));
  background = ColorRGBA(1, 1, 1, 0);
  root->UI_DispatchDrawFromRoot(&background, &target.drawbot, false);
  EXPECT_EQ(RecordingTarget::Count(target.Take(), "PaintRect"), 1) << "the child's own rectangle only";
}

TEST_F(DrawTraversal, AHiddenRootDrawsNothing) {
  AddPaintingView("a", 0, 0, 10, 10, 3, &log, root.get());
  root->UI_Show(false);
  Paint();
  EXPECT_TRUE(log.empty());
}

TEST_F(DrawTraversal, ACustomDrawFunctionAnsweringTrueReplacesUI_Draw) {
  auto a = AddPaintingView("a", 0, 0, 10, 10, 3, &log, root.get());
  auto b = AddPaintingView("b", 0, 0, 10, 10, 3, &log, root.get());
  a->UI_SetCustomDrawFunction(boost::make_shared<boost::function<bool(UI_Node const*, drawbot::Drawbot*)>>(
      [&](UI_Node const* inNode, drawbot::Drawbot*) {
        log.push_back("custom-a");
        EXPECT_EQ(inNode, a.get());
        return true;
      }));
  b->UI_SetCustomDrawFunction(boost::make_shared<boost::function<bool(UI_Node const*, drawbot::Drawbot*)>>(
      [&](UI_Node const*, drawbot::Drawbot*) {
        log.push_back("custom-b");
        return false;
      }));
  Paint();
  EXPECT_EQ(log, (Strings{"custom-a", "custom-b", "b"}));
}

TEST_F(DrawTraversal, AChildRemovingALaterSiblingWhileDrawingStopsItFromBeingDrawn) {
  auto a = AddPaintingView("a", 0, 0, 10, 10, 3, &log, root.get());
  auto b = AddPaintingView("b", 0, 0, 10, 10, 3, &log, root.get());
  AddPaintingView("c", 0, 0, 10, 10, 3, &log, root.get());
  a->onDraw = [&](drawbot::Drawbot*) { root->ChildRemove(b.get()); };
  Paint();
  EXPECT_EQ(log, (Strings{"a", "c"}));
}

TEST_F(DrawTraversal, AChildRemovingItselfAndDroppingItsLastReferenceDoesNotCrash) {
  bool aliveDuringDraw = false;
  {
    auto a = AddPaintingView("a", 0, 0, 10, 10, 3, &log, root.get());
    a->onDraw = [&, raw = a.get()](drawbot::Drawbot*) {
      root->ChildRemove(raw);
      aliveDuringDraw = raw->GetRefCount() > 0;  // the traversal still holds it
    };
  }
  AddPaintingView("b", 0, 0, 10, 10, 3, &log, root.get());
  Paint();
  EXPECT_TRUE(aliveDuringDraw);
  EXPECT_EQ(log, (Strings{"a", "b"}));
  EXPECT_EQ(root->ChildSize(), 1u);
}

TEST_F(DrawTraversal, ChildrenPaintInTheColoursOfTheirTheme) {
  auto a = AddPaintingView("a", 0, 0, 10, 10, 19, &log, root.get());
  a->SetCustomThemeColor(20, ColorRGBA(0, 1, 0, 1));
  auto b = AddPaintingView("b", 0, 0, 10, 10, 20, &log, a.get());
  b->SetCustomThemeColor(20, ColorRGBA(0, 0, 1, 1));
  Paint();
  auto paints = PaintRects(target.Take());
  ASSERT_EQ(paints.size(), 2u);
  EXPECT_EQ(paints[0].color, Theme::Get().GetColor(19));
  EXPECT_EQ(paints[1].color, ColorRGBA(0, 0, 1, 1));
}

}  // namespace
}  // namespace norvik::ui::test
