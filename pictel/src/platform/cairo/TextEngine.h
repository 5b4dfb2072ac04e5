#pragma once

#include <map>
#include <mutex>
#include <string>

#include "CairoPointers.h"

namespace velkui::pictel::cairo {

// The process's text machinery: one font map and two layout contexts that
// differ only in glyph anti-aliasing. Font options are fixed (grey
// anti-aliasing, no hinting, no hint metrics, unrounded glyph positions) so
// that text measures and renders the same on every machine and at every scale.
class TextEngine {
 public:
  // Raises error 20 when the font machinery cannot be started.
  static TextEngine& Get();

  TextEngine(const TextEngine&) = delete;
  TextEngine& operator=(const TextEngine&) = delete;

  PangoContext* GetContext(bool antiAliased) const {
    return antiAliased ? smoothContext_.get() : monoContext_.get();
  }
  // Whether the font configuration has a family of exactly this name (ignoring case).
  bool HasFamily(const std::string& family);
  // The family fontconfig picks for a generic sans-serif request.
  std::string GetDefaultSansFamily() const;

 private:
  TextEngine();

  PangoContextPtr NewContext(cairo_antialias_t antialias) const;

  std::unique_ptr<PangoFontMap, GObjectRelease> fontMap_;
  PangoContextPtr smoothContext_;
  PangoContextPtr monoContext_;
  std::mutex familiesMutex_;
  std::map<std::string, bool> knownFamilies_;
};

}  // namespace velkui::pictel::cairo
