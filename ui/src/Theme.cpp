#include <velkui/ui/Theme.h>

#include <velkui/pictel/Gradients.h>

#include <algorithm>
#include <cmath>

#include <velkcore/Error.h>
#include <velkui/pictel/ColorConversion.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/ui/ThemePalette.h>

namespace velkui::ui {

namespace {

constexpr char16_t kDefaultFace[] = u"Tahoma";
// Far more than any control uses; guards against a count that would exhaust memory.
constexpr ThemeFontIndex kMaxFontCount = 4096;
constexpr ThemeFontIndex kPlatformFaceFonts[] = {0, 1, 2, 3, 4, 6, 7};

struct InstalledTheme {
  std::unique_ptr<Theme> theme;
  std::uint64_t highestRetiredCount = 0;
};

InstalledTheme& Installed() {
  static InstalledTheme installed;
  return installed;
}

// The default face when the font configuration has it, else the platform
// face: a face the drawing layer does not know would fail every text draw.
velkcore::UTF16String InitialFace() {
  if (pictel::HasFontFamily(kDefaultFace)) return kDefaultFace;
  return pictel::GetPlatformUIFontFamily();
}

bool IsFinite(const pictel::ColorRGBA& c) {
  return std::isfinite(c.red) && std::isfinite(c.green) && std::isfinite(c.blue) &&
         std::isfinite(c.alpha);
}

pictel::ColorRGBA MixRGB(const pictel::ColorRGBA& from, const pictel::ColorRGBA& to, float t) {
  return {from.red + (to.red - from.red) * t, from.green + (to.green - from.green) * t,
          from.blue + (to.blue - from.blue) * t, from.alpha};
}

}  // namespace

Theme::Theme(ThemeFontIndex fontCount) : brightness_(GetDefaultBrightness()) {
  velkcore::RequireInput(fontCount <= kMaxFontCount);
  const velkcore::UTF16String face = InitialFace();
  for (ThemeFontIndex index = 0; index < fontCount; ++index) {
    fontNames_.emplace(index, face);
    fontSizes_.emplace(index, kDefaultFontSize);
  }
  DoSetFontNames();
  Theme::DoSetBrightness(brightness_);
}

Theme::~Theme() = default;

void Theme::Initialize(std::unique_ptr<Theme> theme) {
  velkcore::RequireInput(theme != nullptr);
  InstalledTheme& installed = Installed();
  velkcore::RequireInput(installed.theme == nullptr);
  theme->changeCount_ = std::max(theme->changeCount_, installed.highestRetiredCount + 1);
  installed.theme = std::move(theme);
  // Gradients that fall back to one colour take the installed theme's brightness.
  utils::SetGradientBrightnessFunction([] {
    return IsInitialized() ? Get().GetBrightness() : GetDefaultBrightness();
  });
}

Theme& Theme::Get() {
  InstalledTheme& installed = Installed();
  velkcore::RequireInput(installed.theme != nullptr);
  return *installed.theme;
}

bool Theme::IsInitialized() {
  return Installed().theme != nullptr;
}

void Theme::Terminate() {
  InstalledTheme& installed = Installed();
  // Uninstalled before it dies, so that its destructor and anything it calls see no theme.
  std::unique_ptr<Theme> retired = std::move(installed.theme);
  if (retired == nullptr) return;
  installed.highestRetiredCount =
      std::max(installed.highestRetiredCount, retired->GetThemeChangeCount());
}

bool Theme::HasColor(ThemeColorIndex index) const {
  return colors_.contains(index);
}

const pictel::ColorRGBA& Theme::GetColor(ThemeColorIndex index) const {
  const auto found = colors_.find(index);
  velkcore::RequireInput(found != colors_.end());
  return found->second;
}

const velkcore::UTF16String& Theme::GetFontName(ThemeFontIndex index) const {
  const auto found = fontNames_.find(index);
  velkcore::RequireInput(found != fontNames_.end());
  return found->second;
}

float Theme::GetFontSize(ThemeFontIndex index) const {
  const auto found = fontSizes_.find(index);
  velkcore::RequireInput(found != fontSizes_.end());
  return found->second;
}

bool Theme::HasFont(ThemeFontIndex index) const {
  return fontNames_.contains(index) && fontSizes_.contains(index);
}

void Theme::SetBrightness(float brightness) {
  velkcore::RequireInput(std::isfinite(brightness));
  DoSetBrightness(brightness);
  ApplyTinting();
}

void Theme::SetTinting(const pictel::ColorRGBA& tint) {
  velkcore::RequireInput(IsFinite(tint));
  DoSetTinting(tint);
}

void Theme::Update() {
  SetBrightness(GetBrightness());
}

void Theme::SetColor(ThemeColorIndex index, const pictel::ColorRGBA& color) {
  velkcore::RequireInput(IsFinite(color));
  colors_.insert_or_assign(index, color);
}

void Theme::SetFontName(ThemeFontIndex index, const velkcore::UTF16String& name) {
  velkcore::RequireInput(!name.empty());
  fontNames_.insert_or_assign(index, name);
  fontSizes_.emplace(index, kDefaultFontSize);
}

void Theme::SetFontSize(ThemeFontIndex index, float size) {
  velkcore::RequireInput(std::isfinite(size) && size > 0);
  fontSizes_.insert_or_assign(index, size);
  fontNames_.emplace(index, InitialFace());
}

void Theme::NotifyThemeChanged() const {
  ++changeCount_;
  // Nothing of this object may be touched after the call: a function may terminate the theme.
  themeChangedFunctions_.Call();
}

void Theme::InstallThemeChangedFunction(const ThemeChangedFunctionPtr& function) {
  themeChangedFunctions_.Add(function);
}

bool Theme::RemoveThemeChangedFunction(const ThemeChangedFunctionPtr& function) {
  return themeChangedFunctions_.Remove(function);
}

float Theme::DoGetBrightness() const {
  return brightness_;
}

void Theme::DoSetBrightness(float brightness) {
  brightness_ = brightness;
  for (const ThemePaletteRow& row : GetDefaultThemePalette()) {
    for (ThemeColorIndex index = row.first; index <= row.last; ++index) {
      colors_.insert_or_assign(index, row.color);
    }
  }
}

void Theme::DoSetTinting(const pictel::ColorRGBA& tint) {
  tint_ = tint;
  Update();
}

void Theme::DoSetFontNames() {
  const velkcore::UTF16String face = pictel::GetPlatformUIFontFamily();
  for (const ThemeFontIndex index : kPlatformFaceFonts) {
    const auto found = fontNames_.find(index);
    if (found != fontNames_.end()) found->second = face;
  }
}

void Theme::ApplyTinting() {
  float tintHue = 0, tintSaturation = 0, tintValue = 0;
  pictel::RGBtoHSB(tint_, tintHue, tintSaturation, tintValue, false);
  const float strength = std::clamp(tint_.alpha, 0.0f, 1.0f);
  if (!(tintSaturation > 0) || !(strength > 0)) return;
  for (auto& [index, color] : colors_) {
    float hue = 0, saturation = 0, value = 0;
    pictel::RGBtoHSB(color, hue, saturation, value, false);
    if (saturation >= tintSaturation) continue;
    const pictel::ColorRGBA tinted = pictel::HSBtoRGB(tintHue, tintSaturation, value, color.alpha);
    color = MixRGB(color, tinted, strength);
  }
}

float GetDefaultBrightness() {
  return 0.5f;
}

std::uint64_t GetThemeChangeCount() {
  return Theme::IsInitialized() ? Theme::Get().GetThemeChangeCount() : 0;
}

void InstallThemeChangedFunction(const ThemeChangedFunctionPtr& function) {
  Theme::Get().InstallThemeChangedFunction(function);
}

}  // namespace velkui::ui
