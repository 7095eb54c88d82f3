// The state stack, the policies and their error texts, and the wrappers.
#include <gtest/gtest.h>

#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "support/drawbot/RecordingSupplier.h"
#include "support/tarsel/ErrorText.h"
#include "tarsel/ThrowError.h"

namespace norvik::drawbot {
namespace {

using tarsel::geom::MatrixT;
using tarsel::geom::PointT;
using tarsel::geom::RectT;
using testing::RecordingSupplier;

using norvik::test::ErrorOf;

TEST(StateStack, PopRestoresPoliciesTransformAndClip) {
  SurfaceP surface(NewOSSupplier(), 50, 50);
  surface->PushStateStack();
  surface->SetAntiAliasPolicy(kAntiAliasHighQuality);
  surface->SetInterpolationPolicy(kInterpolationHighQuality);
  surface->SetTextDisplayPolicy(kTextDisplaySmooth);
  surface->Transform(MatrixT<float>::Translation(5, 7));
  PathP clip(NewOSSupplier());
  clip->AddRect(RectT<long>(0, 0, 10, 10));
  surface->Clip(*clip, kFillWinding);
  EXPECT_EQ(surface->GetClipBounds(), RectT<long>(0, 0, 10, 10));
  surface->PopStateStack();

  EXPECT_EQ(surface->GetAntiAliasPolicy(), kAntiAliasNone);
  EXPECT_EQ(surface->GetInterpolationPolicy(), kInterpolationNearestNeighbor);
  EXPECT_EQ(surface->GetTextDisplayPolicy(), kTextDisplayGridFitted);
  MatrixT<float> m;
  surface->GetTransform(&m);
  EXPECT_TRUE(m.IsIdentity());
  EXPECT_EQ(surface->GetClipBounds(), RectT<long>(0, 0, 50, 50));
}

TEST(StateStack, APopWithoutAPushKeepsTheBaseRecord) {
  SurfaceP surface(NewOSSupplier(), 10, 10);
  surface->SetAntiAliasPolicy(kAntiAlias);
  surface->PopStateStack();
  surface->PopStateStack();
  EXPECT_EQ(surface->GetAntiAliasPolicy(), kAntiAlias);
  surface->PushStateStack();
  surface->SetAntiAliasPolicy(kAntiAliasNone);
  surface->PopStateStack();
  EXPECT_EQ(surface->GetAntiAliasPolicy(), kAntiAlias);
}

TEST(StateStack, TransformAppliesTheNewMatrixToPointsFirst) {
  SurfaceP surface(NewOSSupplier(), 10, 10);
  surface->Transform(MatrixT<float>::Translation(10, 0));
  surface->Transform(MatrixT<float>::Scale(2, 2));
  MatrixT<float> m;
  surface->GetTransform(&m);
  PointT<float> p = m.Transform(PointT<float>(1, 1));
  EXPECT_FLOAT_EQ(p.x, 12);
  EXPECT_FLOAT_EQ(p.y, 2);
}

TEST(Policies, UnknownValuesRaiseTheirOwnTexts) {
  SurfaceP surface(NewOSSupplier(), 10, 10);
  EXPECT_EQ(ErrorOf([&] { surface->SetAntiAliasPolicy(static_cast<AntiAliasPolicy>(7)); }),
            "Unknown Anti-Alias Policy.");
  EXPECT_EQ(ErrorOf([&] { surface->SetInterpolationPolicy(static_cast<InterpolationPolicy>(-1)); }),
            "Unknown Interpolation Policy.");
  PathP path(NewOSSupplier());
  path->AddRect(RectT<long>(0, 0, 4, 4));
  BrushP brush(NewOSSupplier(), ColorRGBA(1, 0, 0, 1));
  EXPECT_EQ(ErrorOf([&] { surface->FillPath(*brush, *path, static_cast<FillType>(2)); }), "Unknown Fill Type.");
  PenP pen(NewOSSupplier(), ColorRGBA(), 1);
  EXPECT_EQ(ErrorOf([&] { pen->SetLineCap(static_cast<LineCap>(3)); }), "Unknown Line Cap Type.");
  EXPECT_EQ(ErrorOf([&] { pen->SetLineJoin(static_cast<LineJoin>(9)); }), "Unknown Line Join Type.");
  std::vector<unsigned char> pixels(16);
  EXPECT_EQ(ErrorOf([&] {
              BufferImageP(NewOSSupplier(), 2, 2, 8, kPixelLayoutARGB, pixels.data(), nullptr);
            }),
            "Unsupported Pixel Format.");
  // A refused value leaves the policy as it was.
  EXPECT_EQ(surface->GetAntiAliasPolicy(), kAntiAliasNone);
}

TEST(Policies, AReferenceSurfacePassesPoliciesToTheSurfaceItRefersTo) {
  SupplierInterface const* supplier = NewOSSupplier();
  SurfaceP outer(supplier, 40, 40);
  RectT<long> part(10, 10, 5, 5);
  SurfaceP reference(supplier->NewReferenceSurface(outer.Get(), false, &part));
  reference->SetAntiAliasPolicy(kAntiAlias);
  EXPECT_EQ(outer->GetAntiAliasPolicy(), kAntiAlias);
  EXPECT_EQ(reference->GetClipBounds(), part);
  reference.Reset();
  // Releasing the reference gives the outer surface its own state back.
  EXPECT_EQ(outer->GetAntiAliasPolicy(), kAntiAliasNone);
  EXPECT_EQ(outer->GetClipBounds(), RectT<long>(0, 0, 40, 40));
  RectT<long> outside(50, 50, 5, 5);
  EXPECT_EQ(SurfaceP(supplier->NewReferenceSurface(outer.Get(), true, &outside))->GetClipBounds(),
            RectT<long>(0, 0, 40, 40)) << "nothing of the rectangle is in the clip: all of the outer surface";
}

TEST(DegenerateInput, DrawsNothingAndPushesNoState) {
  RecordingSupplier supplier;
  SurfaceP surface(supplier.NewOffscreenSurface(100, 100, false));
  BrushP brush(&supplier, ColorRGBA());
  FontP font(&supplier, u"DejaVu Sans", u"", 12);
  ImageP image(supplier.NewBufferImage(4, 4, 16, kPixelLayoutBGRAPremul, nullptr, nullptr));
  surface->PaintRect(ColorRGBA(), RectT<float>(0, 0, 0, 10));
  surface->PaintRect(ColorRGBA(), RectT<float>(0, 0, 10, -1));
  surface->DrawString(*brush, *font, nullptr, PointT<float>(0, 0), kTextAlignLeft, kTextTruncationNone, 0);
  unsigned short const empty[] = {0};
  surface->DrawString(*brush, *font, empty, PointT<float>(0, 0), kTextAlignLeft, kTextTruncationEnd, 10);
  surface->DrawImage(supplier, *image, RectT<float>(0, 0, 0, 10), nullptr, 1);
  surface->DrawImage(supplier, *image, RectT<float>(0, 0, 10, 10), nullptr, 0);
  surface->DrawImage(supplier, *image, RectT<float>(0, 0, 10, 10), nullptr, 1.5f);
  surface->DrawImage(*image, PointT<float>(0, 0), -0.5f);
  EXPECT_TRUE(supplier.GetCalls().empty()) << supplier.GetOps().size() << " calls, first " << supplier.GetOps()[0];
}

TEST(Wrappers, ANullSupplierLeavesEveryWrapperEmptyWithoutAnError) {
  EXPECT_TRUE(PenP(nullptr, ColorRGBA(), 1).IsNull());
  EXPECT_TRUE(BrushP(nullptr, ColorRGBA()).IsNull());
  EXPECT_TRUE(PathP(nullptr).IsNull());
  EXPECT_TRUE(FontP(nullptr, u"No Such Family", u"", 12).IsNull());
  EXPECT_TRUE(LinearShaderP(nullptr, PointT<float>(), PointT<float>(1, 0), ColorRGBA(), ColorRGBA()).IsNull());
  EXPECT_TRUE(FileImageP(nullptr, kImageFileTypePNG, "missing.png", 0).IsNull());
  EXPECT_TRUE(SurfaceP(nullptr, 10, 10).IsNull());
}

TEST(Wrappers, AnObjectOfAnotherSupplierRaisesUnspecifiedDrawingError) {
  RecordingSupplier recorder;
  SurfaceP surface(NewOSSupplier(), 10, 10);
  PathP foreignPath(&recorder);
  foreignPath->AddRect(RectT<long>(0, 0, 5, 5));
  BrushP brush(NewOSSupplier(), ColorRGBA());
  BrushP foreignBrush(&recorder, ColorRGBA());
  PathP path(NewOSSupplier());
  path->AddRect(RectT<long>(0, 0, 5, 5));
  EXPECT_EQ(ErrorOf([&] { surface->FillPath(*brush, *foreignPath, kFillWinding); }), "Unspecified drawing error.");
  EXPECT_EQ(ErrorOf([&] { surface->FillPath(*foreignBrush, *path, kFillWinding); }), "Unspecified drawing error.");
  EXPECT_EQ(ErrorOf([&] { surface->Clip(*foreignPath, kFillWinding); }), "Unspecified drawing error.");
  FontP foreignFont(&recorder, u"DejaVu Sans", u"", 12);
  unsigned short const text[] = {'a', 0};
  EXPECT_EQ(ErrorOf([&] { surface->MeasureStringWidth(*foreignFont, text, -1); }), "Unspecified drawing error.");
}

TEST(Wrappers, TheSupplierOffersShadersOnlyWhileTheyAreEnabled) {
  SupplierInterface* supplier = NewOSSupplier();
  supplier->SetShadersEnabled(false);
  EXPECT_FALSE(supplier->SupportsLinearShader());
  EXPECT_FALSE(supplier->SupportsRadialShader());
  supplier->SetShadersEnabled(true);
  EXPECT_TRUE(supplier->SupportsLinearShader());
  EXPECT_EQ(NewOSSupplier(), supplier) << "one supplier for the process";
}

}  // namespace
}  // namespace norvik::drawbot
