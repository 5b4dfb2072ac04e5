#include <velkui/ui/DefaultKeyframeTheme.h>

#include <cmath>
#include <span>

#include <velkcore/Error.h>
#include <velkcore/Resources.h>
#include <velkui/ui/KeyframeThemeParser.h>
#include <velkui/ui/ThemePalette.h>
#include <velkui/utility/LibraryResources.h>

namespace velkui::ui {

namespace {

// The default tracks, read once; never installed, it only interpolates.
class DefaultTracks final : public KeyframeThemeEditor {
 public:
  DefaultTracks() : KeyframeThemeEditor(0) {
    KeyframeThemeParser parser(*this);
    parser.Parse(GetDefaultKeyframeThemeText());
  }
  using KeyframeThemeEditor::InterpolateColor;
};

const DefaultTracks& GetDefaultTracks() {
  static const DefaultTracks tracks;
  return tracks;
}

}  // namespace

std::string_view GetDefaultKeyframeThemeText() {
  const std::span<const unsigned char> bytes =
      velkcore::GetBinaryFromModule(utility::LibraryResources(), kDefaultKeyframeThemeName, "xml");
  return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

void LoadDefaultKeyframeTheme(KeyframeThemeEditor& editor) {
  KeyframeThemeParser parser(editor);
  parser.Parse(GetDefaultKeyframeThemeText());
  editor.Update();
  editor.NotifyThemeChanged();
}

std::vector<std::pair<ThemeColorIndex, pictel::ColorRGBA>> GetDefaultKeyframeThemeColors(
    float brightness) {
  velkcore::RequireInput(std::isfinite(brightness));
  const DefaultTracks& tracks = GetDefaultTracks();
  std::vector<std::pair<ThemeColorIndex, pictel::ColorRGBA>> colors;
  // The theme file tracks library colours only, all within the palette.
  for (ThemeColorIndex index = 0; index < kThemePaletteSize; ++index) {
    if (!tracks.HasColorTrack(index)) continue;
    pictel::ColorRGBA color{0, 0, 0, 1};
    tracks.InterpolateColor(index, brightness, color);
    colors.emplace_back(index, color);
  }
  return colors;
}

}  // namespace velkui::ui
