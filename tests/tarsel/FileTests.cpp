// Files, folders, byte streams and path helpers, in a temporary folder.
#include <gtest/gtest.h>

#include <sys/stat.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

#include "tarsel/FileSupport.h"
#include "tarsel/FileUtils.h"
#include "tarsel/ThrowError.h"

using namespace tarsel::filesupport;
namespace FileUtils = tarsel::utility::FileUtils;
namespace fs = std::filesystem;

namespace {

UTF16String U(const fs::path& p) { return tarsel::utility::UTF8to16(p.native()); }

class FileTests : public ::testing::Test {
 protected:
  void SetUp() override {
    mRoot = fs::temp_directory_path() / ("norvik_file_tests_" + std::to_string(::getpid()));
    fs::remove_all(mRoot);
    fs::create_directories(mRoot);
  }
  void TearDown() override {
    std::error_code error;
    fs::permissions(mRoot, fs::perms::owner_all, fs::perm_options::add, error);
    fs::remove_all(mRoot, error);
  }
  fs::path Write(const std::string& name, const std::string& content) {
    const fs::path path = mRoot / name;
    std::ofstream(path, std::ios::binary) << content;
    return path;
  }

  fs::path mRoot;
};

}  // namespace

TEST_F(FileTests, AFileExistsOnlyWhenThereIsAFileAtItsPathAndNonAsciiNamesRoundTripThroughUtf16) {
  const fs::path path = Write("a.txt", "x");
  EXPECT_TRUE(File(path).Exists());
  EXPECT_TRUE(File(U(path)).Exists()) << "the UTF-16 form names the same file";
  EXPECT_FALSE(File(mRoot / "missing.txt").Exists());
  EXPECT_FALSE(File(mRoot).Exists()) << "a folder is not a file";
  const UTF16String name = u"r\u00e9sum\u00e9 \u2603.xml";
  const File file = Dir(mRoot).GetFile(name);
  std::ofstream(file.GetPath()) << "x";
  EXPECT_TRUE(File(file.GetFullPath()).Exists());
  EXPECT_EQ(name, file.GetName());
}

TEST_F(FileTests, ReadOnlyFollowsTheWritePermission) {
  const fs::path path = Write("ro.txt", "x");
  EXPECT_FALSE(File(path).IsReadOnly());
  fs::permissions(path, fs::perms::owner_write | fs::perms::group_write | fs::perms::others_write,
                  fs::perm_options::remove);
  if (::geteuid() != 0) {
    EXPECT_TRUE(File(path).IsReadOnly());
  }
  EXPECT_FALSE(File(mRoot / "missing").IsReadOnly()) << "a missing file is not read-only";
}

TEST_F(FileTests, ParentAndFullPathAreNormalised) {
  const File file(mRoot / "sub" / ".." / "x.txt");
  EXPECT_EQ(U(mRoot / "x.txt"), file.GetFullPath());
  EXPECT_EQ(U(mRoot), Dir(file.GetPath().parent_path()).GetFullPath()) << "no trailing separator";
  EXPECT_EQ(u"/", Dir(fs::path("/")).GetFullPath());
  EXPECT_EQ(U(mRoot), Dir(mRoot / "sub" / "").Parent().GetFullPath()) << "a trailing separator names the same folder";
  EXPECT_EQ(U(mRoot / "sub" / ".."), U(file.Parent().GetPath()));
}

TEST_F(FileTests, FoldersAreCreatedWithTheirParentsAndDeletedWithTheirContentButNeverOverAFile) {
  const Dir deep(mRoot / "a" / "b" / "c");
  EXPECT_FALSE(deep.Exists());
  EXPECT_TRUE(deep.Create());
  EXPECT_TRUE(deep.Exists());
  EXPECT_TRUE(deep.Create()) << "creating an existing folder succeeds";
  std::ofstream((deep.GetPath() / "f.txt")) << "content";
  const Dir a(mRoot / "a");
  EXPECT_TRUE(a.Delete());
  EXPECT_FALSE(a.Exists());
  EXPECT_FALSE(a.Delete()) << "nothing left to delete";
  const fs::path plain = Write("plain", "x");
  EXPECT_FALSE(Dir(plain).Create()) << "a file stands there";
  EXPECT_FALSE(Dir(plain).Delete()) << "Delete must not remove a file";
  EXPECT_TRUE(File(plain).Exists());
}

TEST_F(FileTests, PackageDirIsTheFolderOfTheRunningProgram) {
  const Dir package = Dir::PackageDir();
  ASSERT_TRUE(package.Exists());
  EXPECT_TRUE(fs::equivalent(package.GetPath() / fs::read_symlink("/proc/self/exe").filename(),
                             fs::read_symlink("/proc/self/exe")));
}

TEST_F(FileTests, SymbolicLinksResolveToTheirFinalTarget) {
  const fs::path target = Write("target.txt", "x");
  fs::create_symlink(target, mRoot / "link1");
  fs::create_symlink(mRoot / "link1", mRoot / "link2");
  EXPECT_TRUE(fs::equivalent(target, ResolveIfAliasFileOnly(File(mRoot / "link2")).GetPath()));
  EXPECT_EQ(U(target), U(ResolveIfAliasFileOnly(File(mRoot / "link2")).GetPath()));
  EXPECT_EQ(U(target), U(ResolveIfAliasFileOnly(File(target)).GetPath())) << "a plain file is itself";
  fs::create_symlink(mRoot / "nowhere", mRoot / "dangling");
  EXPECT_EQ(U(mRoot / "dangling"), U(ResolveIfAliasFileOnly(File(mRoot / "dangling")).GetPath()));
}

TEST_F(FileTests, AByteStreamReadsBlocksAtAnyOffset) {
  const fs::path path = Write("data.bin", std::string("0123456789"));
  auto stream = OpenFileByteStream(File(path));
  EXPECT_EQ(10u, stream->Length());
  char buffer[8] = {};
  EXPECT_EQ(4u, stream->ReadBlock(3, buffer, 4));
  EXPECT_EQ("3456", std::string(buffer, 4));
  EXPECT_EQ(2u, stream->ReadBlock(8, buffer, 8)) << "short read at the end";
  EXPECT_EQ("89", std::string(buffer, 2));
  EXPECT_EQ(0u, stream->ReadBlock(10, buffer, 8));
  EXPECT_EQ(0u, stream->ReadBlock(1000, buffer, 8));
  EXPECT_EQ(1u, stream->ReadBlock(0, buffer, 1)) << "reading again after the end works";
  EXPECT_EQ('0', buffer[0]);
}

TEST_F(FileTests, OpeningAStreamOnAMissingFileOrAFolderRaises) {
  EXPECT_THROW(OpenFileByteStream(File(mRoot / "missing")), tarsel::config::Exception);
  EXPECT_THROW(OpenFileByteStream(File(mRoot)), tarsel::config::Exception);
}

TEST_F(FileTests, FileExistsAndRemoveFileWorkByText) {
  const fs::path path = Write("gone.txt", "x");
  EXPECT_TRUE(FileUtils::FileExists(U(path)));
  EXPECT_TRUE(FileUtils::RemoveFile(U(path)));
  EXPECT_FALSE(FileUtils::FileExists(U(path)));
  EXPECT_FALSE(FileUtils::RemoveFile(U(path)));
  fs::create_directories(mRoot / "folder");
  EXPECT_FALSE(FileUtils::RemoveFile(U(mRoot / "folder")));
  EXPECT_TRUE(fs::exists(mRoot / "folder"));
}

TEST(FileUtilsTests, BuildPathSpecJoinsWithExactlyOneSeparator) {
  EXPECT_EQ(u"a/b/c.xml", FileUtils::BuildPathSpec(u"a/b", u"c.xml"));
  EXPECT_EQ(u"a/b/c.xml", FileUtils::BuildPathSpec(u"a/b/", u"c.xml"));
  EXPECT_EQ(u"/abs/c", FileUtils::BuildPathSpec(u"a", u"/abs/c"));
  EXPECT_EQ(u"c", FileUtils::BuildPathSpec(u"", u"c"));
  EXPECT_EQ(u"a", FileUtils::BuildPathSpec(u"a", u""));
}

TEST(FileUtilsTests, TheConfigFolderFollowsXdgConfigHomeThenHome) {
  const char* oldXdg = std::getenv("XDG_CONFIG_HOME");
  const std::string savedXdg = oldXdg ? oldXdg : "";
  const char* oldHome = std::getenv("HOME");
  const std::string savedHome = oldHome ? oldHome : "";

  ::setenv("XDG_CONFIG_HOME", "/somewhere/config", 1);
  EXPECT_EQ(u"/somewhere/config", U(FileUtils::GetUserConfigDir().GetPath()));
  ::setenv("XDG_CONFIG_HOME", "relative/is/ignored", 1);
  ::setenv("HOME", "/home/someone", 1);
  EXPECT_EQ(u"/home/someone/.config", U(FileUtils::GetUserConfigDir().GetPath()));
  ::unsetenv("XDG_CONFIG_HOME");
  EXPECT_EQ(u"/home/someone/.config", U(FileUtils::GetUserConfigDir().GetPath()));

  if (oldXdg) ::setenv("XDG_CONFIG_HOME", savedXdg.c_str(), 1);
  if (oldHome) ::setenv("HOME", savedHome.c_str(), 1); else ::unsetenv("HOME");
}
