#include <velkcore/Error.h>
#include <velkcore/Resources.h>

#include <gtest/gtest.h>

#include "CoreTestSupport.h"

#include <string_view>

namespace velkcore_test {
const velkcore::ResourceModule& TestResources();
}

using namespace velkcore;

TEST(Resources, CompiledFilesAreFoundByNameAndCaseInsensitiveType) {
  const ResourceModule& module = velkcore_test::TestResources();
  EXPECT_EQ(module.moduleName, "velkcore_tests");
  EXPECT_EQ(module.entries.size(), 2u);
  const auto xml = GetBinaryFromModule(module, "Empty", "XML");
  EXPECT_EQ(std::string_view(reinterpret_cast<const char*>(xml.data()), xml.size()),
            "<prop.map version=\"4\"><prop.list/></prop.map>\n");
  const auto png = GetBinaryFromModule(module, "Marker", "png");
  ASSERT_EQ(png.size(), 18u);
  EXPECT_EQ(png[0], 0x89);
  EXPECT_EQ(png[17], 'y');
}

TEST(Resources, MissingResourceNamesItselfInTheError) {
  const ResourceModule& module = velkcore_test::TestResources();
  const auto e = velkcore_test::ErrorOf([&] { GetBinaryFromModule(module, "Empty", "png"); });
  ASSERT_TRUE(e);
  EXPECT_EQ(e->GetCategory(), 105);
  EXPECT_EQ(e->GetNumber(), 20);
  EXPECT_STREQ(e->what(), "Unable to access resource 'Empty' (type png)");
  EXPECT_EQ(module.Find("Nope", "xml"), nullptr);
}
