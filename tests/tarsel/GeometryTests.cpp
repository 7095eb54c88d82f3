#include <gtest/gtest.h>

#include "tarsel/Flags.h"
#include "tarsel/MatrixT.h"
#include "tarsel/RectT.h"
#include "tarsel/ThrowError.h"

using namespace tarsel::geom;

TEST(RectT, RightAndBottomEdgesAreOutside) {
  RectF r(10, 20, 30, 40);
  EXPECT_TRUE(r.Contains(PointF(10, 20)));
  EXPECT_TRUE(r.Contains(PointF(39.99f, 59.99f)));
  EXPECT_FALSE(r.Contains(PointF(40, 30)));
  EXPECT_FALSE(r.Contains(PointF(20, 60)));
}

TEST(RectT, IntersectionAndUnionIgnoreEmptySides) {
  RectL a(0, 0, 10, 10), b(5, 5, 10, 10), empty(100, 100, 0, 5);
  EXPECT_EQ(a.Intersection(b), RectL(5, 5, 5, 5));
  EXPECT_TRUE(a.Intersection(RectL(10, 0, 5, 5)).IsEmpty());
  EXPECT_EQ(a.Union(b), RectL(0, 0, 15, 15));
  EXPECT_EQ(a.Union(empty), a);
  EXPECT_FALSE(a.Intersects(RectL(10, 0, 5, 5)));
}

TEST(MatrixT, SingularMatrixAnswersFalseOrThrowsTheMatrixError) {
  MatrixF singular(1, 2, 2, 4, 0, 0);
  MatrixF copy = singular;
  EXPECT_FALSE(copy.Invert(false));
  EXPECT_EQ(copy, singular);
  try {
    copy.Invert(true);
    FAIL() << "no exception";
  } catch (const tarsel::config::Exception& e) {
    EXPECT_STREQ(e.what(), "Matrix cannot be inverted.");
    EXPECT_EQ(e.GetKeyPath(), "tarsel/geom/matrix/Error/NonInvertableMatrix");
  }
}

TEST(Flags, TestRequiresEveryBit) {
  tarsel::utility::Flags<unsigned char> mods(2 | 4);
  EXPECT_TRUE(mods.Test(2));
  EXPECT_TRUE(mods.Test(2 | 4));
  EXPECT_FALSE(mods.Test(2 | 16));
  EXPECT_TRUE(mods.TestAny(2 | 16));
  mods.Clear(2);
  EXPECT_EQ(mods.Get(), 4);
  EXPECT_FALSE(mods.Test(0));
}
