// The manager an application creates comes with the image cache, the
// platform's drawing supplier and, when a maker is installed, the resource
// manager over the library's own resources. This program links no layer that
// installs a maker, so the tests install their own.
#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "drawbot/DrawbotWrappers.h"
#include "drawbot/SupplierInterface.h"
#include "tarsel/ThrowError.h"
#include "ui/ModuleResourceManager.h"
#include "ui/OS_NodeManager.h"

namespace norvik::ui::test {
namespace {

// Records what it is asked for and answers bytes that are no picture.
class ProbeResources : public ResourceManager {
 public:
  static std::vector<std::string>& Requests() {
    static std::vector<std::string> sRequests;
    return sRequests;
  }
  static int& Made() {
    static int sMade = 0;
    return sMade;
  }
  static std::unique_ptr<ResourceManager> Make() {
    ++Made();
    return std::make_unique<ProbeResources>();
  }

  void GetBinary(UTF16String const& inName, UTF16String const& inType, std::vector<char>* outBuffer) const override {
    Requests().push_back(Narrow(inName) + "." + Narrow(inType));
    if (outBuffer) outBuffer->assign({'n', 'o', 'p', 'e'});
  }
  bool HasBinary(UTF16String const&, UTF16String const&) const override { return true; }
  void MakeCursorFromPNG(int, UTF16String const&, short, short, LoadByPolicy) const override {}
  void DisplayCursor(int) const override {}
  void DisposeCursor(int) const override {}
  void GetResourceDataNames(int, UTF16String&, UTF16String&) const override {}

 private:
  static std::string Narrow(UTF16String const& inText) {
    return tarsel::utility::ToStdString(tarsel::utility::UTF16to8(inText));
  }
};

// Installs a maker for the length of one test and puts the previous one back.
class PlatformManager : public ::testing::Test {
 protected:
  void Install(ResourceManagerMaker inMaker) {
    const ResourceManagerMaker previous = InstallModuleResourceManagerMaker(inMaker);
    if (!mInstalled) mPrevious = previous;
    mInstalled = true;
  }
  void SetUp() override {
    ProbeResources::Requests().clear();
    ProbeResources::Made() = 0;
  }
  void TearDown() override {
    if (mInstalled) InstallModuleResourceManagerMaker(mPrevious);
  }

 private:
  ResourceManagerMaker mPrevious = nullptr;
  bool mInstalled = false;
};

TEST_F(PlatformManager, WithoutAMakerItHasTheCacheAndTheSharedSupplierThatOutlivesItButNoResources) {
  Install(nullptr);
  EXPECT_EQ(NewModuleResourceManager(), nullptr);
  drawbot::SupplierInterface* shared = nullptr;
  {
    OS_NodeManager manager;
    EXPECT_NE(manager.GetDrawbotImageResourceCache(), nullptr);
    shared = manager.GetOSDrawSupplier();
    EXPECT_EQ(shared, drawbot::NewOSSupplier());
    EXPECT_THROW(manager.GetResourceManager(), tarsel::config::Exception);
  }
  OS_NodeManager again;
  EXPECT_EQ(again.GetOSDrawSupplier(), shared);
  drawbot::SurfaceP surface(shared, 4, 4);
  EXPECT_TRUE(static_cast<bool>(surface)) << "still alive and working";
}

TEST_F(PlatformManager, EachManagerReadsImagesThroughItsOwnResourceManagerWithThePlatformSupplier) {
  Install(&ProbeResources::Make);
  {
    OS_NodeManager first;
    EXPECT_NE(dynamic_cast<ProbeResources*>(&first.GetResourceManager()), nullptr);
  }
  OS_NodeManager manager;
  EXPECT_NE(dynamic_cast<ProbeResources*>(&manager.GetResourceManager()), nullptr);
  EXPECT_EQ(ProbeResources::Made(), 2);
  // The probe's bytes are no PNG: the platform decoder refuses them, which
  // shows the read went from the cache through the probe to the decoder.
  EXPECT_THROW(manager.GetImage(manager.GetOSDrawSupplier(), "Gripper", drawbot::kImageFileTypePNG),
               tarsel::config::Exception);
  EXPECT_EQ(ProbeResources::Requests(), std::vector<std::string>{"Gripper.png"});
  EXPECT_EQ(manager.GetDrawbotImageResourceCache()->GetSize(), 0u);
}

}  // namespace
}  // namespace norvik::ui::test
