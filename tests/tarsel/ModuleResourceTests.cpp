// Resources compiled into the library, and functions found by name.
#include <gtest/gtest.h>

#include <dlfcn.h>

#include <cmath>
#include <cstring>
#include <string>

#include "tarsel/ModuleResources.h"
#include "tarsel/PropListUtils.h"

using namespace tarsel::resources;

TEST(ModuleResourceTests, TheEmbeddedDocumentIsExactlyWhatTheWriterProduces) {
  std::vector<unsigned char> buffer;
  EXPECT_TRUE(ModuleHasBinary(kThisModule, "examplePropList", "XML")) << "names and types ignore case";
  ASSERT_TRUE(GetBinaryFromModule(kThisModule, "ExamplePropList", "xml", buffer));
  const std::string text(buffer.begin(), buffer.end());
  tarsel::proplist::PropList list;
  tarsel::proplist::utils::ReadPropList(text, list);
  UTF16String title;
  ASSERT_TRUE(list.GetValue("Title", title));
  EXPECT_EQ(u"Exemple d'\u00e9t\u00e9", title);
  tarsel::geom::PointT<long> origin;
  ASSERT_TRUE(tarsel::proplist::utils::ReadPoint32(list, "Origin", origin));
  EXPECT_EQ(tarsel::geom::PointT<long>(12, -7), origin);
  const UTF8String written = tarsel::proplist::utils::WritePropList(list);
  EXPECT_EQ(text, std::string(written.data(), written.size()));
}

TEST(ModuleResourceTests, FunctionsAreFoundByNameInAModuleOrInTheProcess) {
  void* libm = ::dlopen("libm.so.6", RTLD_NOW | RTLD_LOCAL);
  ASSERT_NE(nullptr, libm);
  using Unary = double (*)(double);
  Unary cosine = GetFunctionPointerFromModule<Unary>(libm, "cos");
  ASSERT_NE(nullptr, cosine);
  EXPECT_DOUBLE_EQ(1.0, cosine(0.0));
  EXPECT_EQ(nullptr, GetFunctionPointerFromModuleImpl(libm, "no_such_function_here"));
  std::vector<unsigned char> buffer;
  EXPECT_FALSE(ModuleHasBinary(libm, "ExamplePropList", "XML")) << "a module without embedded resources has none";
  EXPECT_FALSE(GetBinaryFromModule(libm, "ExamplePropList", "XML", buffer));
  buffer = {1, 2, 3};
  EXPECT_FALSE(GetBinaryFromModule(kThisModule, "NoSuchResource", "XML", buffer));
  EXPECT_EQ((std::vector<unsigned char>{1, 2, 3}), buffer) << "a missing resource leaves the buffer alone";
  ::dlclose(libm);

  using Length = std::size_t (*)(const char*);
  Length length = GetFunctionPointerFromModule<Length>(kThisModule, "strlen");
  ASSERT_NE(nullptr, length);
  EXPECT_EQ(5u, length("hello"));
  EXPECT_EQ(nullptr, GetFunctionPointerFromModuleImpl(kThisModule, nullptr));
}
