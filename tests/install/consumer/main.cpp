// A host program that only sees the installed package.
#include <velkcore/velkcore.h>
#include <velkui/velkui.h>

#include <cstdio>

int main() {
  const auto text = velkcore::NumberToString(1234.5, 1, velkcore::kFormatUseSeparator |
                                                            velkcore::kFormatNoLocalization);
  if (velkcore::UTF16to8(text) != "1,234.5") {
    std::puts("velkcore does not work from the installed package");
    return 1;
  }
  if (velkui::utility::LibraryResources().moduleName != "velkui") {
    std::puts("velkui's resources are missing from the installed package");
    return 1;
  }
  std::puts("ok");
  return 0;
}
