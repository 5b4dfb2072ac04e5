#include <velkui/ui/KeyframeThemeEditor.h>

#include <algorithm>
#include <cmath>
#include <iterator>
#include <optional>

#include <velkcore/Error.h>
#include <velkui/pictel/ColorConversion.h>

namespace velkui::ui {

namespace {

using KeyValue = KeyframeThemeEditor::KeyValue;
using ColorTrack = KeyframeThemeEditor::ColorTrack;

bool IsValidKey(float key, const KeyValue& v) {
  return std::isfinite(key) && std::isfinite(v.hue) && std::isfinite(v.saturation) &&
         std::isfinite(v.value) && std::isfinite(v.alpha);
}

float Lerp(float from, float to, float t) {
  return from == to ? from : from + (to - from) * t;
}

// The unclamped hue, saturation, value and alpha of `track` (not empty) at `brightness`.
KeyValue ValuesAt(const ColorTrack& track, float brightness) {
  const auto next = track.upper_bound(brightness);
  // Beyond either end the nearest key's values hold.
  if (next == track.end()) return std::prev(next)->second;
  if (next == track.begin()) return next->second;

  const auto previous = std::prev(next);
  const KeyValue& from = previous->second;
  if (from.hold) return from;

  const KeyValue& to = next->second;
  const float key = previous->first;
  const float span = next->first - key;
  const float t = (brightness - key) / span;
  KeyValue result;
  result.value = Lerp(from.value, to.value, t);
  result.alpha = Lerp(from.alpha, to.alpha, t);
  // Hue and saturation follow the interpolated value rather than the brightness.
  const float valueT = (result.value - key) / span;
  result.hue = Lerp(from.hue, to.hue, valueT);
  result.saturation = Lerp(from.saturation, to.saturation, valueT);
  return result;
}

pictel::ColorRGBA ToColor(const KeyValue& v) {
  // A pathological track (keys a denormal apart) may overflow the hue.
  float hue = std::isfinite(v.hue) ? std::fmod(std::trunc(v.hue), 360.0f) : 0.0f;
  const float saturation = std::clamp(v.saturation, 0.0f, 1.0f);
  const float value = std::clamp(v.value, 0.0f, 1.0f);
  const float alpha = std::clamp(v.alpha, 0.0f, 1.0f);
  if (saturation <= 0) hue = 0;
  return pictel::HSBtoRGB(hue, saturation, value, alpha);
}

float ColorValue(const pictel::ColorRGBA& c) {
  return std::max({c.red, c.green, c.blue});
}

// Where along the segment from `a` to `b` the value `v` is reached, if it is.
std::optional<float> SegmentReaches(const ColorTrack::value_type& a,
                                    const ColorTrack::value_type& b, float v) {
  const float w0 = a.second.value;
  const float w1 = a.second.hold ? w0 : b.second.value;
  if (v < std::min(w0, w1) || v > std::max(w0, w1)) return std::nullopt;
  if (w0 == w1) return a.first;
  return a.first + (v - w0) / (w1 - w0) * (b.first - a.first);
}

}  // namespace

KeyframeThemeEditor::KeyframeThemeEditor(ThemeFontIndex fontCount) : Theme(fontCount) {}

void KeyframeThemeEditor::SetColorTrack(ThemeColorIndex index, const ColorTrack& track) {
  for (const auto& [key, keyValue] : track) velkcore::RequireInput(IsValidKey(key, keyValue));
  tracks_.insert_or_assign(index, track);
}

const KeyframeThemeEditor::ColorTrack& KeyframeThemeEditor::GetColorTrack(
    ThemeColorIndex index) const {
  static const ColorTrack kEmpty;
  const auto found = tracks_.find(index);
  return found == tracks_.end() ? kEmpty : found->second;
}

bool KeyframeThemeEditor::HasColorTrack(ThemeColorIndex index) const {
  return tracks_.contains(index);
}

void KeyframeThemeEditor::SetColorKeyValue(ThemeColorIndex index, float key,
                                           const KeyValue& keyValue) {
  velkcore::RequireInput(IsValidKey(key, keyValue));
  tracks_[index].insert_or_assign(key, keyValue);
}

void KeyframeThemeEditor::ClearColorKeyValue(ThemeColorIndex index) {
  tracks_.erase(index);
}

void KeyframeThemeEditor::ClearColorKeyValues() {
  tracks_.clear();
}

float KeyframeThemeEditor::GetSourceBrightness(ThemeColorIndex index,
                                               const pictel::ColorRGBA& color) const {
  const ColorTrack& track = GetColorTrack(index);
  if (track.empty()) return GetDefaultBrightness();
  const float v = ColorValue(color);

  for (auto key = track.begin(); std::next(key) != track.end(); ++key) {
    if (const auto found = SegmentReaches(*key, *std::next(key), v)) return *found;
  }
  const auto closest =
      std::min_element(track.begin(), track.end(), [v](const auto& a, const auto& b) {
        return std::fabs(a.second.value - v) < std::fabs(b.second.value - v);
      });
  return closest->first;
}

void KeyframeThemeEditor::SetIndependent(ThemeColorIndex index, bool independent) {
  if (independent) {
    independent_.insert(index);
  } else {
    independent_.erase(index);
  }
}

bool KeyframeThemeEditor::GetIndependent(ThemeColorIndex index) const {
  return independent_.contains(index);
}

void KeyframeThemeEditor::DoSetBrightness(float brightness) {
  Theme::DoSetBrightness(brightness);
  for (const auto& [index, track] : tracks_) {
    // An empty track yields nothing, so the index keeps its default colour.
    if (track.empty() || independent_.contains(index)) continue;
    pictel::ColorRGBA color{0, 0, 0, 1};
    InterpolateColor(index, brightness, color);
    SetColor(index, color);
  }
}

void KeyframeThemeEditor::InterpolateColor(ThemeColorIndex index, float brightness,
                                           pictel::ColorRGBA& out) const {
  const ColorTrack& track = GetColorTrack(index);
  if (track.empty()) return;
  out = ToColor(ValuesAt(track, brightness));
}

}  // namespace velkui::ui
