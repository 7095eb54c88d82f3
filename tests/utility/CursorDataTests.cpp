// Cursor data documents: the names of a cursor's resources, the hot spot
// read from its document, and the refusal of documents that are not cursor
// data of this version.
#include <functional>
#include <string>

#include <gtest/gtest.h>

#include "support/utility/MemoryResourceManager.h"
#include "tarsel/ThrowError.h"
#include "utility/CursorUtils.h"
#include "utility/OS_ResourceManager.h"

namespace norvik::utility {
namespace {

std::string ErrorOf(std::function<void()> const& inCall) {
  try {
    inCall();
  } catch (tarsel::config::Exception const& e) {
    return e.what();
  }
  return "no error";
}

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

TEST_F(CursorData, AVersionOneDocumentGivesItsHotSpot) {
  EXPECT_EQ(Load(Document(VersionPair("1.0") + HotSpotPair(7, 12))), HotSpot(7, 12));
}

TEST_F(CursorData, AMissingDocumentGivesTheTopLeftCorner) {
  EXPECT_EQ(LoadCursorHotSpot(u"CursorDataID-999", mResources), HotSpot(0, 0));
}

TEST_F(CursorData, ADocumentWithoutAHotSpotGivesTheTopLeftCorner) {
  EXPECT_EQ(Load(Document(VersionPair("1.0"))), HotSpot(0, 0));
}

TEST_F(CursorData, ADocumentWithoutTheVersionKeyIsNotCursorData) {
  EXPECT_EQ(LoadError(Document(HotSpotPair(1, 1))), "Not a valid cursor data definition.");
  EXPECT_EQ(LoadError(Document("")), "Not a valid cursor data definition.");
}

TEST_F(CursorData, AVersionThatIsNotTextIsNotCursorData) {
  EXPECT_EQ(LoadError(Document("<prop.pair><key>NRK_CursorData</key>" + Int32(1) + "</prop.pair>")),
            "Not a valid cursor data definition.");
}

TEST_F(CursorData, AnotherVersionIsRefused) {
  EXPECT_EQ(LoadError(Document(VersionPair("2.0") + HotSpotPair(1, 1))),
            "Unable to load cursor data file. Incompatible version.");
  EXPECT_EQ(LoadError(Document(VersionPair("1.00") + HotSpotPair(1, 1))),
            "Unable to load cursor data file. Incompatible version.");
  EXPECT_EQ(LoadError(Document(VersionPair("") + HotSpotPair(1, 1))),
            "Unable to load cursor data file. Incompatible version.");
}

TEST_F(CursorData, TextThatIsNotADocumentRaisesTheReadersError) {
  EXPECT_THROW(Load("<prop.map version='1'><prop.list>"), tarsel::config::Exception);
  EXPECT_THROW(Load(""), tarsel::config::Exception);
  EXPECT_THROW(Load(std::string("\0\xff\xfe<", 4)), tarsel::config::Exception);
}

TEST_F(CursorData, CoordinatesBeyondTheShortRangeAreHeldAtItsEnds) {
  EXPECT_EQ(Load(Document(VersionPair("1.0") + HotSpotPair(70000, -70000))),
            HotSpot(32767, -32768));
}

TEST(LibraryCursorData, TheLibrarysOwnDocumentsPutTheHotSpotAtTheTopLeft) {
  OS_ResourceManager resources;
  EXPECT_TRUE(resources.HasBinary(u"CursorDataID-26", u"xml"));
  EXPECT_TRUE(resources.HasBinary(u"CursorDataID-27", u"xml"));
  EXPECT_EQ(LoadCursorHotSpot(u"CursorDataID-26", resources), HotSpot(0, 0));
  EXPECT_EQ(LoadCursorHotSpot(u"CursorDataID-27", resources), HotSpot(0, 0));
}

}  // namespace
}  // namespace norvik::utility
