// Resources carried in the library: lookup by name and type without regard
// to case, the error texts for what is missing, and the artwork set itself.
#include <cstdint>
#include <map>
#include <set>
#include <string>

#include <gtest/gtest.h>

#include "drawbot/DrawbotWrappers.h"
#include "drawbot/SupplierInterface.h"
#include "support/tarsel/ErrorText.h"
#include "tarsel/ThrowError.h"
#include "utility/OS_ResourceManager.h"

namespace norvik::utility {
namespace {

using tarsel::utility::AsciiToUTF16;

using norvik::test::ErrorOf;

// The names a control may ask for, as the library's table holds them.
const char* const kArtwork[] = {
    "%RV4_LINKICON", "%RV4_LINKICON_D", "%RV4_UNLINKICON", "%RV4_UNLINKICON_D", "CHEVRON_D", "CHEVRON_N",
    "CLEAREDITCONTROLDOWN", "CLEAREDITCONTROLNORMAL", "CLOSE_NORMAL", "CLOSE_OVER", "CONSTRAINEDPROPORTIONS",
    "RV4_CLEAREDITCONTROLDOWN", "RV4_CLEAREDITCONTROLDOWN_D", "RV4_CLEAREDITCONTROLNORMAL",
    "RV4_CLEAREDITCONTROLNORMAL_D", "RV4_CLOSE_DOWN", "RV4_CLOSE_DOWN_D", "RV4_CLOSE_NORMAL", "RV4_CLOSE_NORMAL_D",
    "RV4_CLOSE_OVER", "RV4_CLOSE_OVER_D", "RV4_CONSTRAINEDPROPORTIONS", "RV4_CONSTRAINEDPROPORTIONS_D",
    "RV4_FBCOLORDEFAULT", "RV4_FBCOLORDEFAULTREVERSE", "RV4_FBCOLORSWAP", "RV4_FLYOUT", "RV4_FLYOUT_D",
    "RV4_FLYOUT_OVER", "RV4_FLYOUT_OVER_D", "RV4_GRIPPER", "RV4_GRIPPER_D", "RV4_HORIZTOOLBAR-GRIPPER",
    "RV4_HORIZTOOLBAR-GRIPPER_D", "RV4_LINKICON", "RV4_LINKICON_D", "RV4_LOCKED_SM_N", "RV4_LOCKED_SM_N_D",
    "RV4_LOCKED_SM_R", "RV4_LOCKED_SM_R_D", "RV4_PICKWHIP_N", "RV4_PICKWHIP_N_D", "RV4_PICKWHIP_R",
    "RV4_PICKWHIP_R_D", "RV4_POPUP_TOOLSELECT", "RV4_P_ICONWELL_N", "RV4_P_ICONWELL_N_D", "RV4_P_SORTARROW_N",
    "RV4_P_SORTARROW_N_D", "RV4_P_SORTARROW_UP_N", "RV4_P_SORTARROW_UP_N_D", "RV4_SELECTEDTOOLFLYOUT",
    "RV4_SELECTEDTOOLFLYOUT_D", "RV4_TEAROFF", "RV4_TEAROFF_D", "RV4_UNCONSTRAINEDPROPORTIONS",
    "RV4_UNCONSTRAINEDPROPORTIONS_D", "RV4_UNLINKICON", "RV4_UNLINKICON_D", "RV4_UNLOCKED_SM_N",
    "RV4_UNLOCKED_SM_N_D", "RV4_UNLOCKED_SM_R", "RV4_UNLOCKED_SM_R_D", "RV4_VERTTOOLBAR-GRIPPER",
    "RV4_VERTTOOLBAR-GRIPPER_D", "CURSORID-26", "CURSORID-27", "GRIPPER", "HORIZTOOLBAR-GRIPPER", "LOCKED_SM_N",
    "LOCKED_SM_R", "MESSAGEBOXCAUTIONICON", "MESSAGEBOXCAUTIONICON_SM", "MESSAGEBOXINFOICON",
    "MESSAGEBOXINFOICON_SM", "MESSAGEBOXSTOPICON", "MESSAGEBOXSTOPICON_SM", "MULTITAB_NORMAL", "MULTITAB_OVER",
    "PICKWHIP_N", "PICKWHIP_R", "P_EVENTS_CAUTION_SM_N", "P_EXTENDEDWORKSPACEOPTIONS_LG_E",
    "P_EXTENDEDWORKSPACEOPTIONS_LG_N", "P_EXTENDEDWORKSPACEOPTIONS_LG_R", "P_ICONWELL_N", "P_SORTARROW_N",
    "P_SORTARROW_UP_N", "SEARCH_MAGNIFY_NOMENU_DOWN", "SEARCH_MAGNIFY_NOMENU_DOWN_D", "SEARCH_MAGNIFY_NOMENU_NORMAL",
    "SEARCH_MAGNIFY_NOMENU_NORMAL_D", "SEARCH_MAGNIFY_WITHMENU_DOWN", "SEARCH_MAGNIFY_WITHMENU_DOWN_D",
    "SEARCH_MAGNIFY_WITHMENU_NORMAL", "SEARCH_MAGNIFY_WITHMENU_NORMAL_D", "SEARCH_STOP_DOWN", "SEARCH_STOP_DOWN_D",
    "SEARCH_STOP_NORMAL", "SEARCH_STOP_NORMAL_D", "SELECTEDTOOLPOPUPMENU", "SP_ADD_SM_N", "SP_ADD_SM_N_D",
    "TABWELL_GRIPPER", "UNCONSTRAINEDPROPORTIONS", "UNLOCKED_SM_N", "UNLOCKED_SM_R", "VERTTOOLBAR-GRIPPER"};

// Names and types are found whatever their case; a name of another type is
// not found, and a missing resource raises the text naming it and its type.
TEST(ModuleResources, NamesAndTypesAreFoundWhateverTheirCaseAndAMissingOneRaisesItsText) {
  OS_ResourceManager resources;
  EXPECT_FALSE(resources.HasBinary(u"CursorID-26", u"xml"));
  EXPECT_FALSE(resources.HasBinary(u"NoSuchPicture", u"png"));
  std::vector<char> bytes{'k', 'e', 'p', 't'};
  EXPECT_EQ(ErrorOf([&] { resources.GetBinary(u"NoSuchPicture", u"png", &bytes); }),
            "Unable to access resource 'NoSuchPicture' (type png)");
  EXPECT_EQ(ErrorOf([&] { resources.GetBinary(u"RV4_Close_Normal", u"jpg", &bytes); }),
            "Unable to access resource 'RV4_Close_Normal' (type jpg)");
  EXPECT_EQ(std::string(bytes.begin(), bytes.end()), "kept");
  EXPECT_TRUE(resources.HasBinary(u"RV4_Close_Normal", u"png"));
  EXPECT_TRUE(resources.HasBinary(u"rv4_close_normal", u"PNG"));
  EXPECT_TRUE(resources.HasBinary(u"CursorDataID-26", u"xml"));
  std::vector<char> mixed, upper;
  resources.GetBinary(u"Rv4_ClOsE_nOrMaL", u"Png", &mixed);
  resources.GetBinary(u"RV4_CLOSE_NORMAL", u"PNG", &upper);
  EXPECT_FALSE(mixed.empty());
  EXPECT_EQ(mixed, upper);
}

// Each named picture decodes at an icon's size, and each themable one has a
// light panel variant ("_D") of the same size that is another picture.
TEST(ToolkitArtwork, EveryNamedPictureIsCarriedAndDecodesAndThemableOnesHaveALightPanelVariant) {
  OS_ResourceManager resources;
  drawbot::SupplierInterface* supplier = drawbot::NewOSSupplier();
  const std::set<std::string> names(std::begin(kArtwork), std::end(kArtwork));
  std::map<std::string, std::pair<std::vector<char>, drawbot::FileImageP>> decoded;
  for (const std::string& name : names) {
    SCOPED_TRACE(name);
    auto& [bytes, image] = decoded[name];
    ASSERT_NO_THROW(resources.GetBinary(AsciiToUTF16(name), u"png", &bytes));
    image = drawbot::FileImageP(supplier, drawbot::kImageFileTypePNG, bytes.data(),
                                static_cast<unsigned long>(bytes.size()));
    ASSERT_FALSE(image.IsNull());
    EXPECT_TRUE(image->GetWidth() >= 5u && image->GetWidth() <= 32u) << image->GetWidth();
    EXPECT_TRUE(image->GetHeight() >= 5u && image->GetHeight() <= 32u) << image->GetHeight();
  }
  int pairs = 0;
  for (const auto& [name, dark] : decoded) {
    if (name.size() < 3 || name.compare(name.size() - 2, 2, "_D") != 0 || name == "CHEVRON_D") continue;
    SCOPED_TRACE(name);
    ASSERT_TRUE(decoded.count(name.substr(0, name.size() - 2)));
    const auto& light = decoded.at(name.substr(0, name.size() - 2));
    EXPECT_NE(dark.first, light.first);
    EXPECT_EQ(dark.second->GetWidth(), light.second->GetWidth());
    EXPECT_EQ(dark.second->GetHeight(), light.second->GetHeight());
    ++pairs;
  }
  EXPECT_EQ(pairs, 34);
}

}  // namespace
}  // namespace norvik::utility
