#pragma once

#include <map>
#include <set>

#include <velkui/ui/Theme.h>

namespace velkui::ui {

// A theme whose colours follow tracks of key frames over the brightness: per
// colour index, a track maps brightness keys to a hue, saturation, value and
// alpha. Setting the brightness first writes the default palette, then every
// tracked index that is not marked independent gets the colour its track
// yields at that brightness. Tracks usually come from a theme file
// (KeyframeThemeParser).
class KeyframeThemeEditor : public Theme {
 public:
  struct KeyValue {
    float hue = 0;         // degrees
    float saturation = 0;  // 0..1
    float value = 0;       // 0..1, the colour's brightness
    float alpha = 1;       // 0..1
    bool hold = false;     // keep this key's colour up to the next key

    friend bool operator==(const KeyValue&, const KeyValue&) = default;
  };
  using ColorTrack = std::map<float, KeyValue>;

  explicit KeyframeThemeEditor(ThemeFontIndex fontCount = kDefaultFontCount);

  // Keys and the fields of key values must be finite (else the input-contract violation).
  void SetColorTrack(ThemeColorIndex index, const ColorTrack& track);
  // The track of `index`; an empty track when it has none.
  const ColorTrack& GetColorTrack(ThemeColorIndex index) const;
  bool HasColorTrack(ThemeColorIndex index) const;
  // Inserts or replaces the key at `key` of the track of `index`.
  void SetColorKeyValue(ThemeColorIndex index, float key, const KeyValue& keyValue);
  // Removes the whole track of `index`.
  void ClearColorKeyValue(ThemeColorIndex index);
  void ClearColorKeyValues();

  // The brightness at which the track of `index` yields the value (HSB
  // brightness) of `color`: the first place along the track, in key order,
  // where the value is reached; when the track never reaches it, the key whose
  // value comes closest. GetDefaultBrightness when the index has no keys.
  float GetSourceBrightness(ThemeColorIndex index, const pictel::ColorRGBA& color) const;

  // An independent index keeps its default colour whatever its track says.
  void SetIndependent(ThemeColorIndex index, bool independent = true);
  bool GetIndependent(ThemeColorIndex index) const;

  // In strict mode a theme file must be fully well-formed: a key frame lacking
  // a required attribute, a "Theme" element without "t" or an unknown element
  // is an error instead of being skipped.
  void SetStrictMode(bool strict) { strictMode_ = strict; }
  bool GetStrictMode() const { return strictMode_; }

 protected:
  void DoSetBrightness(float brightness) override;
  // The colour the track of `index` yields at `brightness`; `out` is left
  // alone when the index has no keys.
  void InterpolateColor(ThemeColorIndex index, float brightness, pictel::ColorRGBA& out) const;

 private:
  std::map<ThemeColorIndex, ColorTrack> tracks_;
  std::set<ThemeColorIndex> independent_;
  bool strictMode_ = false;
};

}  // namespace velkui::ui
