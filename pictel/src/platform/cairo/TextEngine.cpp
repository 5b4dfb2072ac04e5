#include "TextEngine.h"

#include <fontconfig/fontconfig.h>

#include <velkui/pictel/PictelErrors.h>

namespace velkui::pictel::cairo {

namespace {

struct FcPatternRelease {
  void operator()(FcPattern* pattern) const { FcPatternDestroy(pattern); }
};
struct FcObjectSetRelease {
  void operator()(FcObjectSet* set) const { FcObjectSetDestroy(set); }
};
struct FcFontSetRelease {
  void operator()(FcFontSet* set) const { FcFontSetDestroy(set); }
};

bool FontConfigHasFamily(const std::string& family) {
  const auto* name = reinterpret_cast<const FcChar8*>(family.c_str());
  std::unique_ptr<FcPattern, FcPatternRelease> pattern(FcPatternCreate());
  std::unique_ptr<FcObjectSet, FcObjectSetRelease> objects(FcObjectSetBuild(FC_FAMILY, nullptr));
  if (!pattern || !objects) return false;
  FcPatternAddString(pattern.get(), FC_FAMILY, name);
  std::unique_ptr<FcFontSet, FcFontSetRelease> fonts(
      FcFontList(nullptr, pattern.get(), objects.get()));
  if (!fonts) return false;
  // FcFontList also matches names that differ in blanks: insist on the name.
  for (int i = 0; i < fonts->nfont; ++i) {
    FcChar8* candidate = nullptr;
    for (int n = 0; FcPatternGetString(fonts->fonts[i], FC_FAMILY, n, &candidate) == FcResultMatch;
         ++n) {
      if (FcStrCmpIgnoreCase(candidate, name) == 0) return true;
    }
  }
  return false;
}

}  // namespace

TextEngine& TextEngine::Get() {
  static TextEngine engine;
  return engine;
}

TextEngine::TextEngine() {
  if (FcInit() == FcFalse) ThrowPictelError(kErrorStartupKey, kErrorStartup);
  fontMap_.reset(pango_cairo_font_map_new());
  if (!fontMap_) ThrowPictelError(kErrorStartupKey, kErrorStartup);
  smoothContext_ = NewContext(CAIRO_ANTIALIAS_GRAY);
  monoContext_ = NewContext(CAIRO_ANTIALIAS_NONE);
}

PangoContextPtr TextEngine::NewContext(cairo_antialias_t antialias) const {
  PangoContextPtr context(pango_font_map_create_context(fontMap_.get()));
  if (!context) ThrowPictelError(kErrorStartupKey, kErrorStartup);
  cairo_font_options_t* options = cairo_font_options_create();
  cairo_font_options_set_antialias(options, antialias);
  cairo_font_options_set_hint_style(options, CAIRO_HINT_STYLE_NONE);
  cairo_font_options_set_hint_metrics(options, CAIRO_HINT_METRICS_OFF);
  cairo_font_options_set_subpixel_order(options, CAIRO_SUBPIXEL_ORDER_DEFAULT);
  pango_cairo_context_set_font_options(context.get(), options);
  cairo_font_options_destroy(options);
  pango_cairo_context_set_resolution(context.get(), 96.0);
  pango_context_set_round_glyph_positions(context.get(), FALSE);
  pango_context_set_language(context.get(), pango_language_from_string("en-us"));
  pango_context_set_base_dir(context.get(), PANGO_DIRECTION_LTR);
  return context;
}

bool TextEngine::HasFamily(const std::string& family) {
  std::lock_guard lock(familiesMutex_);
  const auto known = knownFamilies_.find(family);
  if (known != knownFamilies_.end()) return known->second;
  const bool has = FontConfigHasFamily(family);
  knownFamilies_.emplace(family, has);
  return has;
}

std::string TextEngine::GetDefaultSansFamily() const {
  std::unique_ptr<FcPattern, FcPatternRelease> pattern(
      FcNameParse(reinterpret_cast<const FcChar8*>("sans-serif")));
  if (!pattern) return {};
  FcConfigSubstitute(nullptr, pattern.get(), FcMatchPattern);
  FcDefaultSubstitute(pattern.get());
  FcResult result = FcResultNoMatch;
  std::unique_ptr<FcPattern, FcPatternRelease> match(FcFontMatch(nullptr, pattern.get(), &result));
  FcChar8* family = nullptr;
  if (!match || FcPatternGetString(match.get(), FC_FAMILY, 0, &family) != FcResultMatch) {
    return {};
  }
  return reinterpret_cast<const char*>(family);
}

}  // namespace velkui::pictel::cairo
