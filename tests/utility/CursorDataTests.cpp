// Cursor data documents: the names of a cursor's resources, the hot spot
// read from its document, and the refusal of documents that are not cursor
// data of this version.
#include <string>

#include <gtest/gtest.h>

#include "support/utility/MemoryResourceManager.h"
#include "support/tarsel/ErrorText.h"
#include "tarsel/ThrowError.h"
#include "utility/CursorUtils.h"
#include "utility/OS_ResourceManager.h"

namespace norvik::utility {
namespace {

using norvik::test::ErrorOf;

std::pair<short, short> HotSpot(short inX, short inY) { return {inX, inY}; }

std::string Int32(long inValue) {
  return "<int type='signed' size='32'>" + std::to_string(inValue) + "</int>";
}

std::string Document(std::string const& inPairs) {
  return "<?xml version='1.0'?><prop.map version='1'><prop.list>" + inPairs + "</prop.list></prop.map>";
}

std::string VersionPair(std::string const& inVersion) {
  return "<prop.pair><key>NRK_CursorData</key><string>" + inVersion + "</string></prop.pair>";
}

std::string HotSpotPair(long inX, long inY) {
  return "<prop.pair><key>kHotSpot</key><array><array.type><int type='signed' size='32'/></array.type>" +
         Int32(inX) + Int32(inY) + "</array></prop.pair>";
}

class CursorData : public ::testing::Test {
 protected:
  std::pair<short, short> Load(std::string const& inDocument) {
    mResources.Put("CursorDataID-40", "xml", inDocument);
    return LoadCursorHotSpot(u"CursorDataID-40", mResources);
  }
  std::string LoadError(std::string const& inDocument) {
    return ErrorOf([&] { Load(inDocument); });
  }

  testing::MemoryResourceManager mResources;
};

TEST(CursorNames, TheNumberReplacesTheMarkInBothNames) {
  UTF16String png, data;
  GetCursorResourceNames(26, png, data);
  EXPECT_EQ(png, u"CursorID-26");
  EXPECT_EQ(data, u"CursorDataID-26");
  GetCursorResourceNames(-3, png, data);
  EXPECT_EQ(png, u"CursorID--3");
  OS_ResourceManager resources;
  resources.GetResourceDataNames(1234, png, data);
  EXPECT_EQ(png, u"CursorID-1234");
  EXPECT_EQ(data, u"CursorDataID-1234");
}

TEST_F(CursorData, ADocumentGivesItsHotSpotHeldToTheShortRangeOrTheTopLeftCornerWithoutOne) {
  EXPECT_EQ(Load(Document(VersionPair("1.0") + HotSpotPair(7, 12))), HotSpot(7, 12));
  EXPECT_EQ(Load(Document(VersionPair("1.0") + HotSpotPair(70000, -70000))), HotSpot(32767, -32768));
  EXPECT_EQ(Load(Document(VersionPair("1.0"))), HotSpot(0, 0));
  EXPECT_EQ(LoadCursorHotSpot(u"CursorDataID-999", mResources), HotSpot(0, 0)) << "no document at all";
}

TEST_F(CursorData, DocumentsThatAreNotCursorDataOfThisVersionAreRefusedWithTheirTexts) {
  const std::string invalid = "Not a valid cursor data definition.";
  const std::string incompatible = "Unable to load cursor data file. Incompatible version.";
  const std::pair<std::string, std::string> cases[] = {
      {Document(HotSpotPair(1, 1)), invalid},
      {Document(""), invalid},
      {Document("<prop.pair><key>NRK_CursorData</key>" + Int32(1) + "</prop.pair>"), invalid},
      {Document(VersionPair("2.0") + HotSpotPair(1, 1)), incompatible},
      {Document(VersionPair("1.00") + HotSpotPair(1, 1)), incompatible},
      {Document(VersionPair("") + HotSpotPair(1, 1)), incompatible},
  };
  for (const auto& [document, error] : cases) EXPECT_EQ(LoadError(document), error) << document;
  // Text that is no document at all raises the reader's own error.
  for (const std::string& text : {std::string("<prop.map version='1'><prop.list>"), std::string(),
                                  std::string("\0\xff\xfe<", 4)})
    EXPECT_THROW(Load(text), tarsel::config::Exception);
}

}  // namespace
}  // namespace norvik::utility
