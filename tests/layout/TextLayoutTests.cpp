// A label's leaf keeps one line unless wrapping makes the text markedly
// taller, and node leaves never hand a node a non-finite rectangle.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "layout/SmartLayoutBuilder.h"
#include "layout/UI_TextLayout.h"
#include "support/controls/ControlTestSupport.h"

namespace norvik::layout::test {
namespace {

using controls::UI_StaticText;

class TextLayoutTest : public controls::test::ControlTest {};

TEST_F(TextLayoutTest, OneLineOfTextStaysSingleLineAndLongTextWraps) {
  boost::intrusive_ptr<UI_StaticText> shortText(new UI_StaticText(u"Save changes?"));
  UI_TextLayout shortLayout(shortText, 300);
  EXPECT_FALSE(shortText->IsMultiLine());
  const PointF single = shortText->UI_GetRecommendedSize();
  ASSERT_GT(single.y, 0);
  EXPECT_EQ(shortLayout.GetInitialSize(), PointF(std::ceil(single.x + 2), std::ceil(single.y + 1)));

  UTF16String paragraph;
  for (int i = 0; i < 12; ++i) paragraph += u"The document has changes that were never saved. ";
  boost::intrusive_ptr<UI_StaticText> longText(new UI_StaticText(paragraph));
  longText->UI_SetLocalRectF(RectF(20, 30, 50, 10));
  UI_TextLayout longLayout(longText, 300);
  EXPECT_TRUE(longText->IsMultiLine());
  EXPECT_EQ(longText->UI_GetLocalRectF(true).Origin(), PointF(20, 30)) << "measuring leaves the text in place";
  EXPECT_EQ(longLayout.GetInitialSize().x, 302);
  EXPECT_GT(longLayout.GetInitialSize().y, 3 * single.y) << "the wrapped height, not one line's";
}

TEST_F(TextLayoutTest, NoNonFiniteRectangleReachesANode) {
  boost::intrusive_ptr<UI_StaticText> label = Add(new UI_StaticText(u"Name"), RectF(1, 2, 3, 4));
  SmartLayoutBuilder builder;
  const float nan = std::numeric_limits<float>::quiet_NaN();
  builder.AddUINode_Top(label, PointF(nan, std::numeric_limits<float>::infinity()), true,
                        SmartLayoutBuilder::kSpacingCentered);
  builder.GetLayout()->SetLocation(RectF(nan, 10, 80, -std::numeric_limits<float>::infinity()));
  EXPECT_EQ(label->UI_GetLocalRectF(true), RectF(40, 10, 0, 0)) << "an empty piece centred in 80";
}

}  // namespace
}  // namespace norvik::layout::test
