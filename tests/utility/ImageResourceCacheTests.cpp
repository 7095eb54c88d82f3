// The image cache: one decoded image per name, file type and kind of
// supplier, read through a resource manager only on a miss; and the node
// manager's lookup through it.
#include <fstream>
#include <iterator>
#include <memory>
#include <string>

#include <gtest/gtest.h>

#include "drawbot/DrawbotWrappers.h"
#include "drawbot/SupplierInterface.h"
#include "support/drawbot/RecordingSupplier.h"
#include "support/utility/MemoryResourceManager.h"
#include "tarsel/Contract.h"
#include "support/tarsel/ErrorText.h"
#include "tarsel/ThrowError.h"
#include "ui/DrawbotImageResourceCache.h"
#include "ui/OS_NodeManager.h"
#include "ui/UI_NodeManager.h"
#include "utility/OS_ResourceManager.h"

namespace norvik::utility {
namespace {

using drawbot::kImageFileTypePNG;
using ui::DrawbotImageResourceCache;

using norvik::test::ErrorOf;

class ImageCache : public ::testing::Test {
 protected:
  std::string PNGBytes(const char* inName) {
    std::vector<char> bytes;
    mLibrary.GetBinary(tarsel::utility::AsciiToUTF16(inName), u"png", &bytes);
    return std::string(bytes.begin(), bytes.end());
  }

  OS_ResourceManager mLibrary;
  testing::MemoryResourceManager mMemory;
  DrawbotImageResourceCache mCache;
  boost::intrusive_ptr<drawbot::testing::RecordingSupplier> mRecording{new drawbot::testing::RecordingSupplier()};
  boost::intrusive_ptr<drawbot::testing::RecordingSupplier> mOtherRecording{
      new drawbot::testing::RecordingSupplier()};
  drawbot::SupplierInterface* mPlatform = drawbot::NewOSSupplier();
};

TEST_F(ImageCache, ASecondRequestAnswersTheSameImageWithoutReadingAgain) {
  mMemory.Put("RV4_Close_Normal", "png", PNGBytes("RV4_Close_Normal"));
  auto first = mCache.GetImage(&mMemory, mPlatform, "RV4_Close_Normal", kImageFileTypePNG);
  auto second = mCache.GetImage(&mMemory, mPlatform, "RV4_Close_Normal", kImageFileTypePNG);
  ASSERT_TRUE(first);
  EXPECT_EQ(first.get(), second.get());
  EXPECT_EQ(mMemory.GetReadCount(), 1);
  EXPECT_EQ(first->GetWidth(), 12u);
}

TEST_F(ImageCache, SuppliersOfDifferentKindsGetImagesOfTheirOwnAndOfOneKindShareOne) {
  auto platform = mCache.GetImage(&mLibrary, mPlatform, "SP_Add_Sm_N", kImageFileTypePNG);
  auto recording = mCache.GetImage(&mLibrary, mRecording.get(), "SP_Add_Sm_N", kImageFileTypePNG);
  EXPECT_NE(platform.get(), recording.get());
  EXPECT_EQ(mCache.GetSize(), 2u);
  EXPECT_EQ(mCache.FindImage(mPlatform, "SP_Add_Sm_N", kImageFileTypePNG).get(), platform.get());
  EXPECT_EQ(mCache.FindImage(mRecording.get(), "SP_Add_Sm_N", kImageFileTypePNG).get(), recording.get());
  auto sameKind = mCache.GetImage(&mLibrary, mOtherRecording.get(), "SP_Add_Sm_N", kImageFileTypePNG);
  EXPECT_EQ(sameKind.get(), recording.get()) << "two suppliers of one kind share the entry";
  EXPECT_EQ(mCache.GetSize(), 2u);
}

TEST_F(ImageCache, FindDoesNotLoadAndRemoveForgets) {
  EXPECT_FALSE(mCache.FindImage(mPlatform, "SP_Add_Sm_N", kImageFileTypePNG));
  auto image = mCache.GetImage(&mLibrary, mPlatform, "SP_Add_Sm_N", kImageFileTypePNG);
  EXPECT_TRUE(mCache.RemoveCachedImage(mPlatform, "SP_Add_Sm_N", kImageFileTypePNG));
  EXPECT_FALSE(mCache.RemoveCachedImage(mPlatform, "SP_Add_Sm_N", kImageFileTypePNG));
  EXPECT_FALSE(mCache.FindImage(mPlatform, "SP_Add_Sm_N", kImageFileTypePNG));
  auto again = mCache.GetImage(&mLibrary, mPlatform, "SP_Add_Sm_N", kImageFileTypePNG);
  EXPECT_NE(again.get(), image.get());
}

TEST_F(ImageCache, AnImageMadeElsewhereIsAnsweredWithoutTouchingTheResources) {
  drawbot::FileImageP made(mRecording.get(), kImageFileTypePNG, "x", 1);
  mCache.CacheImage(mRecording.get(), "Painted", kImageFileTypePNG, made.GetPtr());
  auto found = mCache.GetImage(&mMemory, mRecording.get(), "Painted", kImageFileTypePNG);
  EXPECT_EQ(found.get(), made.Get());
  EXPECT_EQ(mMemory.GetReadCount(), 0);
}

TEST_F(ImageCache, AMissingNameRaisesTheResourceErrorAndCachesNothing) {
  EXPECT_EQ(ErrorOf([&] { mCache.GetImage(&mLibrary, mPlatform, "RV4_NoSuchIcon_N", kImageFileTypePNG); }),
            "Unable to access resource 'RV4_NoSuchIcon_N' (type png)");
  EXPECT_EQ(mCache.GetSize(), 0u);
}

TEST_F(ImageCache, FileTypesZeroAndOneAskForJpgAndPngAndJpegResourcesDecode) {
  for (const auto& [type, text] : {std::pair{0, "jpg"}, std::pair{1, "png"}, std::pair{2, ""}})
    EXPECT_EQ(ErrorOf([&] { mCache.GetImage(&mMemory, mPlatform, "None", drawbot::ImageFileType(type)); }),
              std::string("Unable to access resource 'None' (type ") + text + ")");
  std::ifstream file(std::string(NORVIK_TEST_DATA_DIR) + "/drawbot/swatch.jpg", std::ios::binary);
  mMemory.Put("Swatch", "jpg", std::string(std::istreambuf_iterator<char>(file), {}));
  auto image = mCache.GetImage(&mMemory, mPlatform, "Swatch", drawbot::kImageFileTypeJPG);
  ASSERT_TRUE(image);
  EXPECT_EQ(image->GetWidth(), 6u);
  EXPECT_EQ(image->GetHeight(), 4u);
  mMemory.Put("Cut", "jpg", "\xFF\xD8\xFF\xE0 not the rest of a JPEG");
  EXPECT_THROW(mCache.GetImage(&mMemory, mPlatform, "Cut", drawbot::kImageFileTypeJPG), tarsel::config::Exception);
}

TEST_F(ImageCache, BytesThatAreNoPictureRaiseTheDecodersErrorAndCacheNothing) {
  mMemory.Put("Broken", "png", "this is not a PNG file");
  EXPECT_THROW(mCache.GetImage(&mMemory, mPlatform, "Broken", kImageFileTypePNG), tarsel::config::Exception);
  EXPECT_EQ(mCache.GetSize(), 0u);
}

TEST_F(ImageCache, AMissingReaderOrSupplierRaisesTheAccessErrorOnAMiss) {
  EXPECT_EQ(ErrorOf([&] { mCache.GetImage(nullptr, mPlatform, "Gripper", kImageFileTypePNG); }),
            "Unable to access resource.");
  EXPECT_EQ(ErrorOf([&] { mCache.GetImage(&mLibrary, nullptr, "Gripper", kImageFileTypePNG); }),
            "Unable to access resource.");
  EXPECT_EQ(mCache.GetSize(), 0u);
  // A hit needs neither: the stored image is answered as it is.
  auto image = mCache.GetImage(&mLibrary, mPlatform, "Gripper", kImageFileTypePNG);
  EXPECT_EQ(mCache.GetImage(nullptr, mPlatform, "Gripper", kImageFileTypePNG).get(), image.get());
}

TEST(NodeManagerImages, ThePlatformManagerReadsTheLibrarysOwnPicturesAsBuilt) {
  ui::OS_NodeManager manager;
  auto* resources = dynamic_cast<OS_ResourceManager*>(&manager.GetResourceManager());
  ASSERT_NE(resources, nullptr) << "the utility layer installs the library's own reader";
  EXPECT_EQ(resources->GetModule(), tarsel::resources::kThisModule);
  const drawbot::ImageInterface* image =
      manager.GetImage(manager.GetOSDrawSupplier(), "RV4_Locked_Sm_N", kImageFileTypePNG);
  ASSERT_NE(image, nullptr);
  EXPECT_EQ(image->GetWidth(), 16u);
  EXPECT_EQ(manager.GetDrawbotImageResourceCache()->GetSize(), 1u);
}

TEST(NodeManagerImages, WithoutACacheGetImageIsAContractViolation) {
  ui::UI_NodeManager manager;
  manager.SetResourceManager(std::make_unique<OS_ResourceManager>());
  manager.TerminateDrawing();
  const long before = tarsel::debug::GetContractViolationCount();
  EXPECT_THROW(manager.GetImage(drawbot::NewOSSupplier(), "Gripper", kImageFileTypePNG), tarsel::config::Exception);
  EXPECT_EQ(tarsel::debug::GetContractViolationCount(), before + 1);
}

}  // namespace
}  // namespace norvik::utility
