#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <memory>

#include <velkcore/SharedFunctions.h>
#include <velkcore/Strings.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::ui {

// A theme colour number (the controls' colour-change maps store it as size_t).
using UI_Color = std::uint64_t;
using ThemeColorIndex = std::uint64_t;
using ThemeFontIndex = std::uint64_t;

using ThemeChangedFunction = std::function<void()>;
using ThemeChangedFunctionPtr = std::shared_ptr<ThemeChangedFunction>;

// The process-wide table of colours and fonts that every control draws with.
// The colours follow one number, the interface brightness, and an optional
// tint; fonts are a face and a size per font index.
//
// Changing colours or fonts does not announce anything by itself: whoever
// changes the theme calls NotifyThemeChanged once the change is complete, which
// bumps the change count that draw caches compare against and runs the
// theme-changed callbacks. Main thread only.
class Theme {
 public:
  static constexpr ThemeFontIndex kDefaultFontCount = 8;
  static constexpr float kDefaultFontSize = 11.0f;

  // Every font index below `fontCount` (at most 4096) starts at size 11 with
  // "Tahoma", or with the platform's user-interface face when the font
  // configuration lacks Tahoma; then DoSetFontNames gives the platform face to
  // the usual text fonts. The colours start as the default palette at the
  // default brightness.
  explicit Theme(ThemeFontIndex fontCount = kDefaultFontCount);
  virtual ~Theme();
  Theme(const Theme&) = delete;
  Theme& operator=(const Theme&) = delete;

  // Installs the process's theme; a theme must not be installed already
  // (Terminate it first). Null is an input-contract violation. The theme's
  // change count is moved past every count seen before in the process, so
  // that no draw cache made earlier (without a theme or under a replaced one)
  // passes for current.
  static void Initialize(std::unique_ptr<Theme> theme);
  // The installed theme; the input-contract violation when there is none.
  static Theme& Get();
  static bool IsInitialized();
  // Destroys the installed theme (nothing happens when there is none).
  static void Terminate();

  virtual bool HasColor(ThemeColorIndex index) const;
  // Ask HasColor first: an index the theme does not hold is an input-contract violation.
  virtual const pictel::ColorRGBA& GetColor(ThemeColorIndex index) const;
  // A font index the theme does not hold is an input-contract violation.
  virtual const velkcore::UTF16String& GetFontName(ThemeFontIndex index) const;
  virtual float GetFontSize(ThemeFontIndex index) const;
  bool HasFont(ThemeFontIndex index) const;

  // Rebuilds every colour for `brightness` (finite) and applies the tint.
  void SetBrightness(float brightness);
  float GetBrightness() const { return DoGetBrightness(); }
  // Greys take on the tint's hue (see DoSetTinting); colours are rebuilt at once.
  void SetTinting(const pictel::ColorRGBA& tint);
  const pictel::ColorRGBA& GetTinting() const { return tint_; }
  // Rebuilds the colours at the current brightness (after key frames changed, say).
  void Update();

  // Inserts or overwrites one colour until the next rebuild. Components must be finite.
  void SetColor(ThemeColorIndex index, const pictel::ColorRGBA& color);
  // The face must not be empty.
  void SetFontName(ThemeFontIndex index, const velkcore::UTF16String& name);
  // The size must be finite and positive.
  void SetFontSize(ThemeFontIndex index, float size);

  // Increments the change count, then calls every theme-changed function in
  // the order they were installed. A slot holding an empty function raises
  // std::bad_function_call. A function may remove functions or even terminate
  // the theme while it is being called.
  void NotifyThemeChanged() const;
  std::uint64_t GetThemeChangeCount() const { return changeCount_; }

  // Adds a function (null is an input-contract violation; one already
  // installed is not added twice).
  void InstallThemeChangedFunction(const ThemeChangedFunctionPtr& function);
  bool RemoveThemeChangedFunction(const ThemeChangedFunctionPtr& function);

 protected:
  virtual float DoGetBrightness() const;
  // Records the brightness and writes the whole default palette (every library
  // colour index, inserted or overwritten); the palette itself does not depend
  // on the brightness.
  virtual void DoSetBrightness(float brightness);
  // Records the tint and rebuilds the colours. A tint whose saturation is s > 0
  // and hue h turns every colour less saturated than s into hue h at
  // saturation s, keeping its brightness and alpha, blended in by the tint's
  // alpha. Black, white and grey tints (the default is opaque black) leave the
  // colours alone.
  virtual void DoSetTinting(const pictel::ColorRGBA& tint);

  // Chooses the platform's user-interface face and gives it to the text fonts
  // 0-4, 6 and 7 (those the theme holds); font 5 keeps its constructor face.
  void DoSetFontNames();

 private:
  void ApplyTinting();

  std::map<ThemeFontIndex, velkcore::UTF16String> fontNames_;
  std::map<ThemeFontIndex, float> fontSizes_;
  velkcore::SharedFunctions<void()> themeChangedFunctions_;
  std::map<ThemeColorIndex, pictel::ColorRGBA> colors_;
  pictel::ColorRGBA tint_{0, 0, 0, 1};
  float brightness_;
  mutable std::uint64_t changeCount_ = 0;
};

// 0.5: the brightness the default palette is designed for.
float GetDefaultBrightness();
// The installed theme's change count; 0 when no theme is installed.
std::uint64_t GetThemeChangeCount();
// Installs `function` on the installed theme (the input-contract violation when there is none).
void InstallThemeChangedFunction(const ThemeChangedFunctionPtr& function);

}  // namespace velkui::ui
