#include <velkui/ui/ThemePalette.h>

#include <algorithm>
#include <array>

#include <velkcore/Error.h>

namespace velkui::ui {

namespace {

constexpr pictel::ColorRGBA Rgb(int red, int green, int blue, float alpha = 1.0f) {
  return {static_cast<float>(red) / 255.0f, static_cast<float>(green) / 255.0f,
          static_cast<float>(blue) / 255.0f, alpha};
}

constexpr pictel::ColorRGBA Grey(int level, float alpha = 1.0f) {
  return Rgb(level, level, level, alpha);
}

constexpr pictel::ColorRGBA kAccent = Rgb(83, 182, 249);
constexpr pictel::ColorRGBA kAccentDark = Rgb(41, 128, 204);
constexpr pictel::ColorRGBA kAccentText = Rgb(30, 110, 190);
constexpr pictel::ColorRGBA kAccentLight = Rgb(198, 228, 251);
constexpr pictel::ColorRGBA kAccentPale = Rgb(232, 243, 253);
constexpr pictel::ColorRGBA kGreen = Rgb(92, 186, 92);
constexpr pictel::ColorRGBA kAmber = Rgb(240, 176, 48);
constexpr pictel::ColorRGBA kRed = Rgb(222, 64, 56);

// clang-format off
constexpr std::array kPalette = {
    // Surfaces and text
    ThemePaletteRow{  0,   0, Grey(255, 0.75f),     "sheen over control faces"},
    ThemePaletteRow{  1,   1, Grey(38),             "text"},
    ThemePaletteRow{  2,   2, Grey(255),            "content background"},
    ThemePaletteRow{  3,   3, Grey(199),            "frame"},
    ThemePaletteRow{  4,   4, Grey(247),            "window and dialog background"},
    ThemePaletteRow{  5,   5, Grey(102),            "secondary text"},
    ThemePaletteRow{  6,   6, Grey(224),            "panel background"},
    ThemePaletteRow{  7,   7, Grey(160),            "disabled text"},
    ThemePaletteRow{  8,   8, Grey(214),            "separator line"},
    ThemePaletteRow{  9,   9, Grey(140),            "strong frame"},
    ThemePaletteRow{ 10,  10, kAccentLight,         "selection background"},
    ThemePaletteRow{ 11,  11, Grey(24),             "selected text"},
    ThemePaletteRow{ 12,  12, Grey(218),            "inactive selection background"},
    ThemePaletteRow{ 13,  13, Grey(0, 0.25f),       "drop shadow"},
    ThemePaletteRow{ 14,  14, Grey(50),             "level meter track"},
    ThemePaletteRow{ 15,  15, Grey(223, 0.5f),      "level meter segment gaps"},
    ThemePaletteRow{ 16,  16, Grey(255, 0.35f),     "hover veil"},
    ThemePaletteRow{ 17,  17, Grey(0, 0.12f),       "pressed veil"},
    // Buttons
    ThemePaletteRow{ 18,  18, kAccent,              "focus ring"},
    ThemePaletteRow{ 19,  19, Grey(160),            "control outline"},
    ThemePaletteRow{ 20,  20, Grey(252),            "control face, top"},
    ThemePaletteRow{ 21,  21, Grey(228),            "control face, bottom"},
    ThemePaletteRow{ 22,  22, Grey(255),            "hovered face, top"},
    ThemePaletteRow{ 23,  23, Grey(238),            "hovered face, bottom"},
    ThemePaletteRow{ 24,  24, Grey(206),            "pressed face, top"},
    ThemePaletteRow{ 25,  25, Grey(220),            "pressed face, bottom"},
    ThemePaletteRow{ 26,  26, Grey(242),            "disabled face, top"},
    ThemePaletteRow{ 27,  27, Grey(236),            "disabled face, bottom"},
    ThemePaletteRow{ 28,  28, Grey(38),             "control label"},
    ThemePaletteRow{ 29,  29, Grey(165),            "disabled control label"},
    ThemePaletteRow{ 30,  30, kAccentDark,          "default button outline"},
    ThemePaletteRow{ 31,  31, Rgb(120, 196, 250),   "default button face, top"},
    ThemePaletteRow{ 32,  32, Rgb(70, 160, 235),    "default button face, bottom"},
    ThemePaletteRow{ 33,  33, Grey(255),            "default button label"},
    // Toggles
    ThemePaletteRow{ 34,  34, Rgb(170, 216, 250),   "toggle on face, top"},
    ThemePaletteRow{ 35,  35, Rgb(128, 194, 246),   "toggle on face, bottom"},
    ThemePaletteRow{ 36,  36, Grey(38),             "check mark"},
    ThemePaletteRow{ 37,  37, Grey(165),            "disabled check mark"},
    ThemePaletteRow{ 38,  38, kAccentDark,          "radio dot"},
    ThemePaletteRow{ 39,  39, Grey(255),            "check box background"},
    // Sliders
    ThemePaletteRow{ 40,  40, Grey(199),            "slider track"},
    ThemePaletteRow{ 41,  41, kAccent,              "slider fill"},
    ThemePaletteRow{ 42,  42, Grey(255),            "slider thumb, top"},
    ThemePaletteRow{ 43,  43, Grey(232),            "slider thumb, bottom"},
    ThemePaletteRow{ 44,  44, Grey(140),            "slider thumb outline"},
    ThemePaletteRow{ 45,  45, Grey(120),            "tick marks"},
    ThemePaletteRow{ 46,  46, Grey(224),            "disabled slider track"},
    ThemePaletteRow{ 47,  47, Rgb(176, 214, 240),   "disabled slider fill"},
    ThemePaletteRow{ 48,  48, Grey(190),            "disabled control outline"},
    // Hot text numbers
    ThemePaletteRow{ 49,  49, kAccentText,          "hot text value"},
    ThemePaletteRow{ 50,  50, Rgb(20, 90, 170),     "hovered hot text value"},
    ThemePaletteRow{ 51,  51, Grey(255),            "hot text edit background"},
    ThemePaletteRow{ 52,  52, Rgb(150, 175, 200),   "disabled hot text value"},
    ThemePaletteRow{ 53,  53, Rgb(30, 110, 190, 0.5f), "hot text underline"},
    // Knobs and angle pickers
    ThemePaletteRow{ 54,  54, Grey(245),            "knob face, top"},
    ThemePaletteRow{ 55,  55, Grey(214),            "knob face, bottom"},
    ThemePaletteRow{ 56,  56, Grey(38),             "knob pointer"},
    ThemePaletteRow{ 57,  57, Grey(199),            "knob ring"},
    ThemePaletteRow{ 58,  58, kAccent,              "knob ring fill"},
    ThemePaletteRow{ 59,  59, Grey(165),            "disabled knob pointer"},
    // Scroll bars
    ThemePaletteRow{ 60,  60, Grey(236),            "scroll track"},
    ThemePaletteRow{ 61,  61, Grey(190),            "scroll thumb"},
    ThemePaletteRow{ 62,  62, Grey(165),            "hovered scroll thumb"},
    ThemePaletteRow{ 63,  63, Grey(140),            "pressed scroll thumb"},
    ThemePaletteRow{ 64,  64, Grey(80),             "scroll arrow"},
    ThemePaletteRow{ 65,  65, Grey(190),            "disabled scroll arrow"},
    ThemePaletteRow{ 66,  69, Grey(236),            "scroll corner; spare"},
    // Lists and trees
    ThemePaletteRow{ 70,  70, Grey(255),            "list background"},
    ThemePaletteRow{ 71,  71, Grey(245),            "alternate row"},
    ThemePaletteRow{ 72,  72, kAccent,              "selected row"},
    ThemePaletteRow{ 73,  73, Grey(255),            "selected row text"},
    ThemePaletteRow{ 74,  74, Grey(214),            "inactive selected row"},
    ThemePaletteRow{ 75,  75, Grey(38),             "inactive selected row text"},
    ThemePaletteRow{ 76,  76, Grey(232),            "grid line"},
    ThemePaletteRow{ 77,  77, Grey(247),            "column header face, top"},
    ThemePaletteRow{ 78,  78, Grey(228),            "column header face, bottom"},
    ThemePaletteRow{ 79,  79, Grey(64),             "column header text"},
    ThemePaletteRow{ 80,  80, Grey(102),            "disclosure triangle"},
    ThemePaletteRow{ 81,  81, kAccentDark,          "drop indicator"},
    ThemePaletteRow{ 82,  82, kAccentPale,          "hovered row"},
    ThemePaletteRow{ 83,  83, Grey(102),            "sort arrow"},
    ThemePaletteRow{ 84,  84, Grey(199),            "column divider"},
    ThemePaletteRow{ 85,  85, kAccent,              "focused row outline"},
    ThemePaletteRow{ 86,  89, Grey(245),            "spare"},
    // Tabs and panel containers
    ThemePaletteRow{ 90,  90, Grey(214),            "tab well"},
    ThemePaletteRow{ 91,  91, Grey(247),            "active tab"},
    ThemePaletteRow{ 92,  92, Grey(228),            "inactive tab"},
    ThemePaletteRow{ 93,  93, Grey(238),            "hovered tab"},
    ThemePaletteRow{ 94,  94, Grey(180),            "tab outline"},
    ThemePaletteRow{ 95,  95, Grey(38),             "active tab text"},
    ThemePaletteRow{ 96,  96, Grey(90),             "inactive tab text"},
    ThemePaletteRow{ 97,  97, Grey(120),            "tab close box"},
    ThemePaletteRow{ 98,  98, kRed,                 "hovered tab close box"},
    ThemePaletteRow{ 99,  99, Grey(240),            "panel header, top"},
    ThemePaletteRow{100, 100, Grey(224),            "panel header, bottom"},
    ThemePaletteRow{101, 101, Grey(50),             "panel header text"},
    ThemePaletteRow{102, 102, Grey(160),            "panel gripper"},
    ThemePaletteRow{103, 103, Grey(180),            "panel outline"},
    ThemePaletteRow{104, 104, Rgb(83, 182, 249, 0.35f), "panel drop target"},
    ThemePaletteRow{105, 109, Grey(224),            "spare"},
    // Menus and pop-ups
    ThemePaletteRow{110, 110, Grey(250),            "menu background"},
    ThemePaletteRow{111, 111, Grey(38),             "menu item text"},
    ThemePaletteRow{112, 112, kAccent,              "highlighted menu item"},
    ThemePaletteRow{113, 113, Grey(255),            "highlighted menu item text"},
    ThemePaletteRow{114, 114, Grey(165),            "disabled menu item text"},
    ThemePaletteRow{115, 115, Grey(222),            "menu separator"},
    ThemePaletteRow{116, 116, Grey(110),            "shortcut text"},
    ThemePaletteRow{117, 117, Grey(38),             "menu check mark"},
    ThemePaletteRow{118, 118, Grey(90),             "submenu arrow"},
    ThemePaletteRow{119, 119, Grey(170),            "menu outline"},
    ThemePaletteRow{120, 120, Grey(0, 0.2f),        "menu shadow"},
    ThemePaletteRow{121, 121, Grey(252),            "pop-up button face, top"},
    ThemePaletteRow{122, 122, Grey(228),            "pop-up button face, bottom"},
    ThemePaletteRow{123, 123, Grey(64),             "pop-up arrow"},
    ThemePaletteRow{124, 124, Grey(244),            "flyout background"},
    ThemePaletteRow{125, 129, Grey(250),            "spare"},
    // Tooltips
    ThemePaletteRow{130, 130, Grey(64),             "tooltip background"},
    ThemePaletteRow{131, 131, Grey(247),            "tooltip text"},
    ThemePaletteRow{132, 132, Grey(38),             "tooltip outline"},
    ThemePaletteRow{133, 139, Grey(64),             "spare"},
    // Dialogs and message boxes
    ThemePaletteRow{140, 140, Grey(247),            "dialog background"},
    ThemePaletteRow{141, 141, Grey(38),             "dialog title"},
    ThemePaletteRow{142, 142, Grey(38),             "dialog message"},
    ThemePaletteRow{143, 143, Grey(236),            "button bar"},
    ThemePaletteRow{144, 144, Grey(214),            "button bar separator"},
    ThemePaletteRow{145, 145, kAccent,              "information icon"},
    ThemePaletteRow{146, 146, kAmber,               "warning icon"},
    ThemePaletteRow{147, 147, kRed,                 "error icon"},
    ThemePaletteRow{148, 148, kAccentDark,          "question icon"},
    ThemePaletteRow{149, 149, Grey(64),             "progress message"},
    ThemePaletteRow{150, 150, Grey(199),            "group box outline"},
    ThemePaletteRow{151, 151, Grey(64),             "group box title"},
    ThemePaletteRow{152, 152, Grey(236),            "page list background"},
    ThemePaletteRow{153, 153, kAccent,              "selected page"},
    ThemePaletteRow{154, 154, Grey(255),            "selected page text"},
    ThemePaletteRow{155, 159, Grey(247),            "spare"},
    // Progress bars
    ThemePaletteRow{160, 160, Grey(224),            "progress track"},
    ThemePaletteRow{161, 161, Rgb(120, 196, 250),   "progress fill, top"},
    ThemePaletteRow{162, 162, Rgb(70, 160, 235),    "progress fill, bottom"},
    ThemePaletteRow{163, 163, Grey(180),            "progress outline"},
    ThemePaletteRow{164, 164, Grey(38),             "progress text"},
    ThemePaletteRow{165, 165, Grey(255, 0.3f),      "indeterminate stripe"},
    ThemePaletteRow{166, 169, Grey(224),            "spare"},
    // Search boxes, path bars and static text
    ThemePaletteRow{170, 170, Grey(255),            "search box background"},
    ThemePaletteRow{171, 171, Grey(180),            "search box outline"},
    ThemePaletteRow{172, 172, Grey(150),            "search placeholder"},
    ThemePaletteRow{173, 173, Grey(120),            "search icon"},
    ThemePaletteRow{174, 174, Grey(150),            "clear button"},
    ThemePaletteRow{175, 175, Grey(240),            "path bar background"},
    ThemePaletteRow{176, 176, Grey(50),             "path segment text"},
    ThemePaletteRow{177, 177, Grey(228),            "hovered path segment"},
    ThemePaletteRow{178, 178, Grey(120),            "path separator"},
    ThemePaletteRow{179, 179, Grey(38),             "static text"},
    ThemePaletteRow{180, 180, Grey(160),            "disabled static text"},
    ThemePaletteRow{181, 181, kAccentDark,          "link"},
    ThemePaletteRow{182, 182, kAccentText,          "hovered link"},
    ThemePaletteRow{183, 183, Grey(64),             "text crawl"},
    ThemePaletteRow{184, 189, Grey(255),            "spare"},
    // Splitters, drag and drop, pick whips
    ThemePaletteRow{190, 190, Grey(214),            "splitter"},
    ThemePaletteRow{191, 191, Grey(199),            "hovered splitter"},
    ThemePaletteRow{192, 192, Grey(150),            "splitter gripper"},
    ThemePaletteRow{193, 193, kAccentDark,          "drag outline"},
    ThemePaletteRow{194, 194, Rgb(83, 182, 249, 0.25f), "drop highlight"},
    ThemePaletteRow{195, 195, kAccent,              "drop highlight outline"},
    ThemePaletteRow{196, 196, kAccentDark,          "pick whip line"},
    ThemePaletteRow{197, 197, kAccent,              "pick whip target"},
    ThemePaletteRow{198, 198, Rgb(83, 182, 249, 0.2f), "rubber band"},
    ThemePaletteRow{199, 199, kAccent,              "rubber band outline"},
    ThemePaletteRow{200, 209, Grey(214),            "spare"},
    // Colour picker and shared panels
    ThemePaletteRow{210, 210, Grey(140),            "colour picker frame"},
    ThemePaletteRow{211, 211, Grey(255),            "picker marker, outer"},
    ThemePaletteRow{212, 212, Grey(0),              "picker marker, inner"},
    ThemePaletteRow{213, 213, Grey(120),            "swatch outline"},
    ThemePaletteRow{214, 214, Grey(255),            "checkerboard, light"},
    ThemePaletteRow{215, 215, Grey(204),            "checkerboard, dark"},
    ThemePaletteRow{216, 216, Grey(240),            "welcome background"},
    ThemePaletteRow{217, 217, kAccentPale,          "welcome header"},
    ThemePaletteRow{218, 218, Grey(38),             "welcome header text"},
    ThemePaletteRow{219, 219, kAccentDark,          "welcome link"},
    ThemePaletteRow{220, 220, Grey(247),            "about background"},
    ThemePaletteRow{221, 221, Grey(64),             "about text"},
    ThemePaletteRow{222, 222, Grey(120),            "about legal text"},
    ThemePaletteRow{223, 239, Grey(240),            "spare"},
    // States
    ThemePaletteRow{240, 240, kGreen,               "success"},
    ThemePaletteRow{241, 241, kAmber,               "caution"},
    ThemePaletteRow{242, 242, kRed,                 "failure"},
    ThemePaletteRow{243, 243, kAccent,              "busy"},
    ThemePaletteRow{244, 244, kAmber,               "modified marker"},
    ThemePaletteRow{245, 245, kRed,                 "required field marker"},
    ThemePaletteRow{246, 246, kRed,                 "record"},
    ThemePaletteRow{247, 247, kRed,                 "playhead"},
    ThemePaletteRow{248, 248, kAmber,               "marker"},
    ThemePaletteRow{249, 256, Grey(160),            "spare"},
    // Level meters
    ThemePaletteRow{257, 257, kGreen,               "level below caution"},
    ThemePaletteRow{258, 258, Rgb(240, 200, 48),    "level between caution and warning"},
    ThemePaletteRow{259, 259, kRed,                 "level above warning"},
    ThemePaletteRow{260, 260, Grey(255),            "peak hold"},
    ThemePaletteRow{261, 261, Rgb(255, 48, 40),     "clip indicator, lit"},
    ThemePaletteRow{262, 262, Grey(80),             "clip indicator, unlit"},
    ThemePaletteRow{263, 263, Grey(102),            "meter scale text"},
    ThemePaletteRow{264, 264, Grey(140),            "meter scale ticks"},
    ThemePaletteRow{265, 265, Grey(38),             "meter background"},
    ThemePaletteRow{266, 266, Grey(24),             "meter outline"},
    ThemePaletteRow{267, 277, Grey(50),             "spare"},
    // Text fields
    ThemePaletteRow{278, 278, Grey(255),            "text field background"},
    ThemePaletteRow{279, 279, Grey(240),            "disabled text field background"},
    ThemePaletteRow{280, 280, Grey(24),             "text field text"},
    ThemePaletteRow{281, 281, Grey(160),            "disabled text field text"},
    ThemePaletteRow{282, 282, Grey(170),            "text field outline"},
    ThemePaletteRow{283, 283, kAccent,              "focused text field outline"},
    ThemePaletteRow{284, 284, kAccentLight,         "text selection"},
    ThemePaletteRow{285, 285, Grey(24),             "selected text in a field"},
    ThemePaletteRow{286, 286, Grey(24),             "caret"},
    ThemePaletteRow{287, 287, Grey(150),            "placeholder text"},
    ThemePaletteRow{288, 289, Grey(255),            "spare"},
    // Rulers and number fields
    ThemePaletteRow{290, 290, Grey(236),            "ruler background"},
    ThemePaletteRow{291, 291, Grey(180),            "ruler outline"},
    ThemePaletteRow{292, 292, Grey(102),            "unit text"},
    ThemePaletteRow{293, 293, Grey(255),            "number field background"},
    ThemePaletteRow{294, 294, Grey(170),            "number field outline"},
    ThemePaletteRow{295, 295, Grey(90),             "spin arrows"},
    ThemePaletteRow{296, 304, Grey(236),            "spare"},
    ThemePaletteRow{305, 305, Grey(90),             "ruler ticks and numbers"},
    ThemePaletteRow{306, 306, kRed,                 "ruler cursor"},
    ThemePaletteRow{307, 307, kAccentDark,          "ruler origin"},
    ThemePaletteRow{308, 308, Rgb(83, 182, 249, 0.25f), "ruler selection"},
    ThemePaletteRow{309, 309, Grey(200),            "disabled control ring"},
    // Dark panes inside the light look (viewers, timelines)
    ThemePaletteRow{310, 310, Grey(38),             "dark pane background"},
    ThemePaletteRow{311, 311, Grey(230),            "dark pane text"},
    ThemePaletteRow{312, 312, Grey(160),            "dark pane secondary text"},
    ThemePaletteRow{313, 313, Grey(24),             "dark pane frame"},
    ThemePaletteRow{314, 314, kAccent,              "dark pane selection"},
    ThemePaletteRow{315, 315, Grey(64),             "dark pane grid"},
    ThemePaletteRow{316, 316, Grey(50),             "timeline background"},
    ThemePaletteRow{317, 317, Grey(140),            "timeline ticks"},
    ThemePaletteRow{318, 318, Grey(80),             "thumbnail frame"},
    ThemePaletteRow{319, 319, kAccent,              "selected thumbnail frame"},
    ThemePaletteRow{320, 339, Grey(38),             "spare"},
    // Toolbars and the selected appearance of buttons
    ThemePaletteRow{340, 340, Grey(240),            "toolbar, top"},
    ThemePaletteRow{341, 341, Grey(224),            "toolbar, bottom"},
    ThemePaletteRow{342, 342, Grey(199),            "toolbar separator"},
    ThemePaletteRow{343, 343, Grey(232),            "hovered toolbar button"},
    ThemePaletteRow{344, 344, Grey(206),            "pressed toolbar button"},
    ThemePaletteRow{345, 345, Grey(64),             "toolbar icon"},
    ThemePaletteRow{346, 346, Grey(170),            "disabled toolbar icon"},
    ThemePaletteRow{347, 347, Rgb(150, 206, 250),   "selected face, top"},
    ThemePaletteRow{348, 348, Rgb(110, 182, 245),   "selected face, bottom"},
    ThemePaletteRow{349, 349, Grey(24),             "selected label"},
    ThemePaletteRow{350, 350, kAccentDark,          "selected outline"},
    ThemePaletteRow{351, 351, Rgb(170, 216, 250),   "hovered selected face, top"},
    ThemePaletteRow{352, 352, Rgb(128, 194, 246),   "hovered selected face, bottom"},
    ThemePaletteRow{353, 353, Rgb(100, 170, 235),   "pressed selected face, top"},
    ThemePaletteRow{354, 354, Rgb(80, 155, 228),    "pressed selected face, bottom"},
    ThemePaletteRow{355, 355, Rgb(170, 200, 225),   "disabled selected outline"},
    ThemePaletteRow{356, 356, Rgb(214, 228, 240),   "disabled selected face"},
    ThemePaletteRow{357, 357, Grey(150),            "disabled selected label"},
    ThemePaletteRow{358, 365, Grey(224),            "spare"},
};
// clang-format on

constexpr bool CoversPaletteWithoutGaps() {
  ThemeColorIndex next = 0;
  for (const ThemePaletteRow& row : kPalette) {
    if (row.first != next || row.last < row.first) return false;
    next = row.last + 1;
  }
  return next == kThemePaletteSize;
}
static_assert(CoversPaletteWithoutGaps(), "palette rows must cover 0..365 in order");

const ThemePaletteRow& RowOf(ThemeColorIndex index) {
  velkcore::RequireInput(index < kThemePaletteSize);
  const auto row =
      std::lower_bound(kPalette.begin(), kPalette.end(), index,
                       [](const ThemePaletteRow& r, ThemeColorIndex i) { return r.last < i; });
  return *row;
}

}  // namespace

std::span<const ThemePaletteRow> GetDefaultThemePalette() {
  return kPalette;
}

const pictel::ColorRGBA& GetDefaultThemeColor(ThemeColorIndex index) {
  return RowOf(index).color;
}

const char* GetDefaultThemeColorRole(ThemeColorIndex index) {
  return RowOf(index).role;
}

}  // namespace velkui::ui
