// A real window on the headless backend: themed nodes in an OS_Window, a
// timer-driven animation, and a tooltip that appears after its delay while
// the pointer rests on a button. Everything runs on the virtual clock; the
// page is the screen as a user would see it.
#include <cmath>
#include <cstdio>
#include <string>
#include <vector>

#include <velkcore/Strings.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/HeadlessPlatform.h>
#include <velkui/ui/OS_Window.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_NodeManager.h>
#include <velkui/ui/UI_SubView.h>
#include <velkui/ui/UI_ToolTipManager.h>

#include "GalleryNodes.h"
#include "GalleryPage.h"
#include "GalleryPainter.h"

namespace gallery {
namespace {

using velkcore::PointT;
using velkcore::RectT;
using velkui::pictel::ColorRGBA;
using velkui::pictel::TextAlignment;
namespace ui = velkui::ui;
namespace pictel = velkui::pictel;

constexpr std::int32_t kScreenWidth = 1360;
constexpr std::int32_t kScreenHeight = 760;
constexpr RectT<std::int32_t> kWindowFrame{36, 36, 980, 660};
constexpr double kRunSeconds = 1.4;
constexpr float kFramesPerSecond = 30.0f;

ColorRGBA Color(ui::ThemeColorIndex index) {
  return ui::Theme::Get().GetColor(index);
}

// What the animation has done so far (shared by the nodes that show it).
struct Transport {
  std::int32_t frame = 0;
  std::vector<float> levels = std::vector<float>(6, 0.0f);
  std::vector<float> peaks = std::vector<float>(6, 0.0f);
  // The first and fourth channels at every frame so far.
  std::vector<std::pair<float, float>> history;
  float Seconds() const { return static_cast<float>(frame) / kFramesPerSecond; }
};

class Toolbar : public ui::UI_SubView {
 public:
  void UI_Draw(pictel::Pictel* context) const override {
    Painter p(context);
    const RectT<float> r = UI_GetLocalRectF(false);
    p.Gradient(r, Color(340), Color(341));
    p.Line({0, r.height - 0.5f}, {r.width, r.height - 0.5f}, Color(342));
    UI_SubView::UI_Draw(context);
  }
};

enum class Glyph { kPlay, kStop, kRecord, kLoop, kMixer };

// A toolbar button: themed faces, hover from the node manager's mouse-over state.
class ToolButton : public ui::UI_SubView {
 public:
  ToolButton(std::u16string label, Glyph glyph) : label_(std::move(label)), glyph_(glyph) {}

  bool UI_InvalidateOnMouseOverChange(bool) const override { return true; }

  void UI_Draw(pictel::Pictel* context) const override {
    Painter p(context);
    const RectT<float> r = UI_GetLocalRectF(false);
    const bool hover = UI_IsMouseOver(true);
    const RectT<float> face{0.5f, 0.5f, r.width - 1, r.height - 1};
    p.Gradient(face, Color(hover ? 22 : 20), Color(hover ? 23 : 21), 4);
    p.StrokeRound(face, 4, Color(hover ? 18 : 19));
    const PointT<float> icon{15, r.height / 2};
    const ColorRGBA ink = Color(345);
    switch (glyph_) {
      case Glyph::kPlay:
        p.Polygon({{icon.x - 4, icon.y - 6}, {icon.x + 6, icon.y}, {icon.x - 4, icon.y + 6}}, ink);
        break;
      case Glyph::kStop:
        p.Fill({icon.x - 5, icon.y - 5, 10, 10}, ink);
        break;
      case Glyph::kRecord:
        p.FillRound({icon.x - 6, icon.y - 6, 12, 12}, 6, Color(246));
        break;
      case Glyph::kLoop:
        p.StrokeRound({icon.x - 6, icon.y - 4, 12, 8}, 4, ink, 1.6f);
        p.Polygon({{icon.x + 1, icon.y - 7}, {icon.x + 5, icon.y - 4}, {icon.x + 1, icon.y - 1}},
                  ink);
        break;
      case Glyph::kMixer:
        for (int i = 0; i < 3; ++i) {
          const float x = icon.x - 5 + static_cast<float>(i) * 5;
          p.Line({x, icon.y - 6}, {x, icon.y + 6}, ink, 1.2f);
          p.Fill({x - 2, icon.y - 3 + static_cast<float>(i * 3 % 7) - 2, 4, 3}, ink);
        }
        break;
    }
    p.Text(label_, {28, r.height / 2 + 4.5f}, Color(28), 12);
  }

 private:
  std::u16string label_;
  Glyph glyph_;
};

class TrackList : public ui::UI_SubView {
 public:
  void UI_Draw(pictel::Pictel* context) const override {
    Painter p(context);
    const RectT<float> r = UI_GetLocalRectF(false);
    p.Fill(r, Color(70));
    p.Gradient({0, 0, r.width, 30}, Color(99), Color(100));
    p.Text(u"Tracks", {12, 20}, Color(101), 12, true);
    p.Text(u"6", {r.width - 12, 20}, Color(5), 11, false, TextAlignment::kEnd);
    static const char16_t* const kNames[] = {u"Lead vocal", u"Backing vocals", u"Acoustic guitar",
                                             u"Bass",       u"Drums",          u"Room mics"};
    static const ColorRGBA kSwatches[] = {{0.90f, 0.36f, 0.33f, 1}, {0.95f, 0.62f, 0.25f, 1},
                                          {0.36f, 0.73f, 0.36f, 1}, {0.26f, 0.60f, 0.90f, 1},
                                          {0.58f, 0.43f, 0.85f, 1}, {0.55f, 0.58f, 0.62f, 1}};
    for (int i = 0; i < 6; ++i) {
      const float top = 30 + static_cast<float>(i) * 34;
      const bool selected = i == 1;
      p.Fill({0, top, r.width, 34}, Color(selected ? 72 : (i % 2 == 0 ? 70 : 71)));
      p.FillRound({12, top + 11, 12, 12}, 3, kSwatches[i]);
      p.Text(kNames[i], {34, top + 21}, Color(selected ? 73 : 1), 12, selected);
      p.Text(i == 4 ? u"M" : u"", {r.width - 14, top + 21}, Color(selected ? 73 : 5), 11, true,
             TextAlignment::kEnd);
      p.Line({0, top + 33.5f}, {r.width, top + 33.5f}, Color(76));
    }
    p.Line({r.width - 0.5f, 0}, {r.width - 0.5f, r.height}, Color(8));
  }
};

class Timeline : public ui::UI_SubView {
 public:
  explicit Timeline(const Transport& transport) : transport_(transport) {}

  void UI_Draw(pictel::Pictel* context) const override {
    Painter p(context);
    const RectT<float> r = UI_GetLocalRectF(false);
    p.FillRound(r, 5, Color(316));
    const float pixelsPerSecond = 120.0f;
    for (int s = 0; s <= static_cast<int>(r.width / pixelsPerSecond); ++s) {
      const float x = 14 + static_cast<float>(s) * pixelsPerSecond;
      p.Line({x, 8}, {x, 20}, Color(317));
      for (int q = 1; q < 4; ++q) {
        const float qx = x + static_cast<float>(q) * pixelsPerSecond / 4;
        if (qx < r.width - 8) p.Line({qx, 14}, {qx, 20}, Color(315));
      }
      char label[16];
      std::snprintf(label, sizeof label, "%d s", s);
      p.Text(velkcore::UTF8to16(label), {x + 4, 18}, Color(312), 10);
    }
    struct Clip {
      int lane;
      float start;
      float length;
      ColorRGBA color;
    };
    const Clip clips[] = {{0, 0.2f, 2.6f, {0.90f, 0.36f, 0.33f, 1}},
                          {0, 3.1f, 2.2f, {0.90f, 0.36f, 0.33f, 1}},
                          {1, 0.9f, 3.4f, {0.95f, 0.62f, 0.25f, 1}},
                          {2, 0.0f, 5.6f, {0.26f, 0.60f, 0.90f, 1}}};
    for (const Clip& clip : clips) {
      const RectT<float> box{14 + clip.start * pixelsPerSecond,
                             28 + static_cast<float>(clip.lane) * 24, clip.length * pixelsPerSecond,
                             20};
      ColorRGBA fill = clip.color;
      fill.alpha = 0.85f;
      p.FillRound(box, 3, fill);
      // A little waveform.
      for (float x = box.left + 4; x < box.left + box.width - 4; x += 3) {
        const float a =
            3.0f + 4.0f * std::fabs(std::sin(x * 0.11f + static_cast<float>(clip.lane)));
        p.Line({x, box.top + 10 - a}, {x, box.top + 10 + a}, {1, 1, 1, 0.55f}, 1.2f);
      }
    }
    const float playhead = 14 + transport_.Seconds() * pixelsPerSecond;
    p.Line({playhead, 4}, {playhead, r.height - 4}, Color(247), 2);
    p.Polygon({{playhead - 5, 4}, {playhead + 5, 4}, {playhead, 10}}, Color(247));
  }

 private:
  const Transport& transport_;
};

// Six level meters, animated by a node timer at 30 frames a second.
class MeterBridge : public ui::UI_SubView {
 public:
  static constexpr std::int32_t kTimerID = 1;

  explicit MeterBridge(Transport& transport) : transport_(transport) {}

  std::vector<ui::UI_Node*> followers;

  bool UI_DoTimerNotify(std::int32_t id) override {
    if (id != kTimerID) return UI_SubView::UI_DoTimerNotify(id);
    ++transport_.frame;
    const float t = static_cast<float>(transport_.frame);
    for (std::size_t i = 0; i < transport_.levels.size(); ++i) {
      const float phase = static_cast<float>(i) * 0.9f;
      const float level =
          0.52f + 0.32f * std::sin(t * 0.23f + phase) + 0.14f * std::sin(t * 0.71f + phase * 2.0f);
      transport_.levels[i] = std::clamp(level, 0.02f, 0.98f);
      transport_.peaks[i] = std::max(transport_.peaks[i] - 0.004f, transport_.levels[i]);
    }
    transport_.history.emplace_back(transport_.levels[0], transport_.levels[3]);
    UI_Invalidate(nullptr, ui::InvalidateFlags{});
    for (ui::UI_Node* follower : followers) follower->UI_Invalidate(nullptr, ui::InvalidateFlags{});
    return true;
  }

  void UI_Draw(pictel::Pictel* context) const override {
    Painter p(context);
    const RectT<float> r = UI_GetLocalRectF(false);
    p.FillRound(r, 6, Color(2));
    p.StrokeRound({0.5f, 0.5f, r.width - 1, r.height - 1}, 6, Color(3));
    p.Text(u"Meter bridge", {16, 24}, Color(1), 13, true);
    p.Text(u"dBFS", {r.width - 16, 24}, Color(263), 10, false, TextAlignment::kEnd);
    const float meterTop = 40;
    const float meterHeight = r.height - meterTop - 34;
    const float slot = (r.width - 60) / static_cast<float>(transport_.levels.size());
    static const char16_t* const kLabels[] = {u"Vox", u"BVs", u"Gtr", u"Bass", u"Kit", u"Room"};
    for (int db = 0; db <= 4; ++db) {
      const float y = meterTop + meterHeight * static_cast<float>(db) / 4.0f;
      char label[8];
      std::snprintf(label, sizeof label, "%d", -db * 12);
      p.Text(velkcore::UTF8to16(label), {40, y + 4}, Color(263), 10, false, TextAlignment::kEnd);
      p.Line({44, y + 0.5f}, {50, y + 0.5f}, Color(264));
    }
    for (std::size_t i = 0; i < transport_.levels.size(); ++i) {
      const float left = 60 + static_cast<float>(i) * slot + slot / 2 - 11;
      const RectT<float> track{left, meterTop, 22, meterHeight};
      p.FillRound(track, 3, Color(265));
      const int segments = 24;
      const float segmentHeight = (meterHeight - 4) / static_cast<float>(segments);
      const int lit = static_cast<int>(transport_.levels[i] * static_cast<float>(segments));
      for (int s = 0; s < segments; ++s) {
        const float y = track.top + track.height - 2 - static_cast<float>(s + 1) * segmentHeight;
        const float share = static_cast<float>(s) / static_cast<float>(segments);
        ColorRGBA color = Color(share > 0.85f ? 259 : share > 0.65f ? 258 : 257);
        if (s >= lit) color.alpha = 0.13f;
        p.Fill({track.left + 3, y + 1, track.width - 6, segmentHeight - 1.5f}, color);
      }
      const float peakY = track.top + track.height - 2 - transport_.peaks[i] * (meterHeight - 4);
      p.Fill({track.left + 3, peakY, track.width - 6, 2}, Color(260));
      p.Text(kLabels[i], {left + 11, r.height - 12}, Color(5), 11, false, TextAlignment::kCenter);
    }
  }

 private:
  Transport& transport_;
};

class TimeReadout : public ui::UI_SubView {
 public:
  explicit TimeReadout(const Transport& transport) : transport_(transport) {}

  void UI_Draw(pictel::Pictel* context) const override {
    Painter p(context);
    const RectT<float> r = UI_GetLocalRectF(false);
    p.FillRound(r, 6, Color(310));
    const float seconds = transport_.Seconds();
    char text[32];
    std::snprintf(text, sizeof text, "00:00:%02d.%02d", static_cast<int>(seconds),
                  static_cast<int>(std::lround(seconds * 100.0f)) % 100);
    p.Text(velkcore::UTF8to16(text), {r.width / 2, 46}, Color(311), 30, true,
           TextAlignment::kCenter);
    char frame[32];
    std::snprintf(frame, sizeof frame, "frame %d  \u00B7  30 fps", transport_.frame);
    p.Text(velkcore::UTF8to16(frame), {r.width / 2, 72}, Color(312), 11, false,
           TextAlignment::kCenter);
  }

 private:
  const Transport& transport_;
};

// The levels of two channels over the frames so far.
class History : public ui::UI_SubView {
 public:
  explicit History(const Transport& transport) : transport_(transport) {}

  void UI_Draw(pictel::Pictel* context) const override {
    Painter p(context);
    const RectT<float> r = UI_GetLocalRectF(false);
    p.FillRound(r, 6, Color(2));
    p.StrokeRound({0.5f, 0.5f, r.width - 1, r.height - 1}, 6, Color(3));
    p.Text(u"Level history", {16, 24}, Color(1), 13, true);
    const RectT<float> plot{16, 38, r.width - 32, r.height - 80};
    p.FillRound(plot, 4, Color(310));
    for (int i = 1; i < 4; ++i) {
      const float y = plot.top + plot.height * static_cast<float>(i) / 4.0f + 0.5f;
      p.Line({plot.left + 4, y}, {plot.left + plot.width - 4, y}, Color(315));
    }
    const std::size_t count = transport_.history.size();
    const float step = count > 1 ? (plot.width - 12) / static_cast<float>(count - 1) : 0.0f;
    const auto trace = [&](bool second, const ColorRGBA& color) {
      PointT<float> previous{};
      for (std::size_t i = 0; i < count; ++i) {
        const float level = second ? transport_.history[i].second : transport_.history[i].first;
        const PointT<float> point{plot.left + 6 + static_cast<float>(i) * step,
                                  plot.top + 6 + (1.0f - level) * (plot.height - 12)};
        if (i > 0) p.Line(previous, point, color, 1.8f);
        previous = point;
      }
    };
    trace(false, {0.90f, 0.36f, 0.33f, 1});
    trace(true, {0.26f, 0.60f, 0.90f, 1});
    p.FillRound({16, r.height - 30, 8, 8}, 4, {0.90f, 0.36f, 0.33f, 1});
    p.Text(u"Vox", {29, r.height - 22}, Color(5), 11);
    p.FillRound({72, r.height - 30, 8, 8}, 4, {0.26f, 0.60f, 0.90f, 1});
    p.Text(u"Bass", {85, r.height - 22}, Color(5), 11);
    p.Text(u"one point per tick", {r.width - 16, r.height - 22}, Color(7), 10, false,
           TextAlignment::kEnd);
  }

 private:
  const Transport& transport_;
};

class StatusBar : public ui::UI_SubView {
 public:
  std::u16string left;
  std::u16string right;

  void UI_Draw(pictel::Pictel* context) const override {
    Painter p(context);
    const RectT<float> r = UI_GetLocalRectF(false);
    p.Fill(r, Color(6));
    p.Line({0, 0.5f}, {r.width, 0.5f}, Color(8));
    p.FillRound({12, r.height / 2 - 4, 8, 8}, 4, Color(240));
    p.Text(left, {26, r.height / 2 + 4}, Color(5), 11);
    p.Text(right, {r.width - 12, r.height / 2 + 4}, Color(5), 11, false, TextAlignment::kEnd);
  }
};

template <typename Node, typename... Args>
boost::intrusive_ptr<Node> Add(ui::UI_Node& parent, const RectT<float>& frame, Args&&... args) {
  return Place(parent, frame, velkcore::MakeIntrusive<Node>(std::forward<Args>(args)...));
}

void DrawPointer(Painter& p, PointT<float> at) {
  const std::vector<PointT<float>> arrow = {{0, 0},   {0, 17},    {4.5f, 13}, {7.5f, 20},
                                            {10, 19}, {7, 12.5f}, {12, 12.5f}};
  std::vector<PointT<float>> outline;
  std::vector<PointT<float>> body;
  for (const PointT<float>& q : arrow) {
    body.push_back({at.x + q.x, at.y + q.y});
  }
  // A dark rim, then the white body slightly inside.
  for (const PointT<float>& q : arrow)
    outline.push_back({at.x + q.x * 1.12f - 0.8f, at.y + q.y * 1.1f - 1.0f});
  p.Polygon(outline, {0.05f, 0.05f, 0.08f, 1});
  p.Polygon(body, {1, 1, 1, 1});
}

// A card on the desktop that tells what the picture shows.
void DrawNotes(pictel::SurfaceInterface& surface, const pictel::SupplierInterface& supplier,
               const std::vector<std::u16string>& lines) {
  pictel::Pictel context(&supplier, &surface);
  Painter p(&context);
  const RectT<float> card{1046, 60, 290, 44.0f + 40.0f * static_cast<float>(lines.size())};
  p.FillRound({card.left + 2, card.top + 4, card.width, card.height}, 10, {0, 0, 0, 0.18f});
  p.FillRound(card, 10, {1, 1, 1, 0.93f});
  p.Text(u"On the virtual clock", {card.left + 18, card.top + 30}, {0.13f, 0.15f, 0.19f, 1}, 14,
         true);
  float y = card.top + 62;
  for (const std::u16string& line : lines) {
    p.FillRound({card.left + 18, y - 9, 7, 7}, 3.5f, {0.16f, 0.45f, 0.86f, 1});
    const pictel::FontP font(supplier, Painter::FontFamily(), u"", 12);
    surface.DrawMultiLineString(*pictel::BrushP(supplier, {0.25f, 0.28f, 0.33f, 1}), *font,
                                line.c_str(), {card.left + 34, y - 15, card.width - 52, 40},
                                TextAlignment::kStart);
    y += 40;
  }
}

boost::intrusive_ptr<pictel::ImageInterface> RenderWindowPage() {
  ui::HeadlessPlatform& headless = ui::HeadlessPlatform::Get();
  headless.SetMonitors(
      {{{0, 0, kScreenWidth, kScreenHeight}, {0, 0, kScreenWidth, kScreenHeight}, 1, true}});
  Transport transport;
  std::u16string tipText = u"Record arms the selected tracks and starts recording (R)";
  std::int32_t paints = 0;
  boost::intrusive_ptr<pictel::ImageInterface> screen;
  {
    const auto window = velkcore::MakeIntrusive<ui::OS_Window>(
        u"Session \u2014 velkui on the headless window system", kWindowFrame,
        ui::kStyleCaption | ui::kStyleSystemMenu);
    window->UI_SetNodeID("GalleryMainWindow");
    const RectT<float> client = window->UI_GetLocalRectF(false);

    auto toolbar = Add<Toolbar>(*window, {0, 0, client.width, 46});
    struct Tool {
      const char16_t* label;
      Glyph glyph;
      float width;
    };
    const Tool tools[] = {{u"Play", Glyph::kPlay, 72},
                          {u"Stop", Glyph::kStop, 72},
                          {u"Record", Glyph::kRecord, 86},
                          {u"Loop", Glyph::kLoop, 72},
                          {u"Mixer", Glyph::kMixer, 80}};
    float x = 12;
    boost::intrusive_ptr<ToolButton> record;
    for (const Tool& tool : tools) {
      auto button = Add<ToolButton>(*toolbar, {x, 9, tool.width, 28}, tool.label, tool.glyph);
      if (tool.glyph == Glyph::kRecord) record = button;
      x += tool.width + (tool.glyph == Glyph::kLoop ? 22 : 8);
    }
    record->UI_SetToolTip(tipText, 0);

    const float bodyTop = 46;
    const float statusHeight = 26;
    Add<TrackList>(*window, {0, bodyTop, 236, client.height - bodyTop - statusHeight});
    const float mainLeft = 236 + 18;
    const float mainWidth = client.width - mainLeft - 18;
    auto timeline = Add<Timeline>(*window, {mainLeft, bodyTop + 16, mainWidth, 110}, transport);
    auto meters = Add<MeterBridge>(
        *window, {mainLeft, bodyTop + 144, mainWidth - 244, client.height - bodyTop - 144 - 44},
        transport);
    auto readout =
        Add<TimeReadout>(*window, {mainLeft + mainWidth - 226, bodyTop + 144, 226, 96}, transport);
    const float historyTop = bodyTop + 144 + 96 + 16;
    auto history = Add<History>(
        *window, {mainLeft + mainWidth - 226, historyTop, 226, client.height - historyTop - 44},
        transport);
    auto status =
        Add<StatusBar>(*window, {0, client.height - statusHeight, client.width, statusHeight});
    meters->followers = {timeline.get(), readout.get(), history.get(), status.get()};

    window->UI_Show(true);
    headless.ProcessEvents();
    meters->UI_InstallTimer(1.0f / kFramesPerSecond, MeterBridge::kTimerID);

    // The pointer comes to rest on the Record button; the tooltip follows
    // after its initial delay, while the meters keep moving.
    const RectT<float> recordFrame = record->UI_LocalToGlobalF(record->UI_GetLocalRectF(false));
    const RectT<std::int32_t> screenClient =
        headless.GetClientRect(window->GetPlatformWindow(false));
    const PointT<std::int32_t> pointer{
        screenClient.left + static_cast<std::int32_t>(recordFrame.left + recordFrame.width * 0.55f),
        screenClient.top + static_cast<std::int32_t>(recordFrame.top + recordFrame.height * 0.6f)};
    headless.MovePointer(pointer);
    status->left = u"Recording armed on 2 tracks";
    headless.RunFor(kRunSeconds);
    char right[96];
    std::snprintf(right, sizeof right, "%d timer ticks \u00B7 %.2f s virtual time", transport.frame,
                  headless.GetTime());
    status->right = velkcore::UTF8to16(right);
    status->UI_Invalidate(nullptr, ui::InvalidateFlags{});
    headless.ProcessEvents();
    paints = headless.GetPaintCount(window->GetPlatformWindow(false));

    screen = headless.RenderScreen();
    const auto supplier = pictel::NewOSSupplier();
    const auto surface = supplier->NewImageSurface(screen.get(), false, nullptr);
    pictel::Pictel context(supplier.get(), surface.get());
    Painter p(&context);
    DrawPointer(p, {static_cast<float>(pointer.x), static_cast<float>(pointer.y)});
    const ui::UI_ToolTipManager* tips = ui::UI_NodeManager::Get()->GetToolTipManager();
    const bool tipShown = tips != nullptr && tips->GetDisplayedTip() != nullptr;
    char ticks[96];
    std::snprintf(ticks, sizeof ticks, "%d ticks of a 34 ms node timer drove the meters",
                  transport.frame);
    char painted[96];
    std::snprintf(painted, sizeof painted,
                  "%d paints: each frame's invalidations came as one repaint", paints);
    DrawNotes(
        *surface, *supplier,
        {u"1.40 s of virtual time, no wall clock and no display", velkcore::UTF8to16(ticks),
         tipShown ? u"The tooltip appeared 0.75 s after the pointer came to rest"
                  : u"No tooltip: something is wrong",
         velkcore::UTF8to16(painted), u"Window and pop-up pixels read back from their surfaces"});
    surface->Flush();
    meters->UI_RemoveTimer(MeterBridge::kTimerID);
  }
  headless.ProcessEvents();
  return screen;
}

const PageRegistration kWindowPage{{"window", 10, &RenderWindowPage}};

}  // namespace
}  // namespace gallery
