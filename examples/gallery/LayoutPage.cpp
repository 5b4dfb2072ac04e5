// The reflowing layout panel in a resizable window on the headless window
// system: rendered wide, then resized by the user (the window manager's size
// message, as a drag of the frame would bring) and rendered again. The page
// shows both screens side by side, with what the arrangement views did as
// read back from the nodes.
#include <algorithm>
#include <cstdio>
#include <set>
#include <string>
#include <vector>

#include <velkcore/Strings.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/HeadlessPlatform.h>
#include <velkui/ui/OS_Window.h>

#include "GalleryPage.h"
#include "GalleryPainter.h"
#include "LayoutPanel.h"

namespace gallery {
namespace {

using velkcore::PointT;
using velkcore::RectT;
using velkui::pictel::ColorRGBA;
using velkui::pictel::TextAlignment;
namespace ui = velkui::ui;
namespace pictel = velkui::pictel;

constexpr std::int32_t kPageWidth = 1360;
constexpr std::int32_t kPageHeight = 704;
// Client areas, in screen pixels, before and after the user's resize.
constexpr RectT<std::int32_t> kWideClient{60, 60, 640, 180};
constexpr RectT<std::int32_t> kNarrowClient{60, 60, 280, 440};
// Where the two screenshots of the window land on the page.
constexpr PointT<float> kWideAt{48, 132};
constexpr PointT<float> kNarrowAt{856, 132};

constexpr ColorRGBA kInk{0.13f, 0.15f, 0.19f, 1};
constexpr ColorRGBA kMutedInk{0.36f, 0.39f, 0.45f, 1};
constexpr ColorRGBA kAccent{0.16f, 0.45f, 0.86f, 1};

std::u16string Text(const char* format, int a, int b = 0) {
  char text[160];
  std::snprintf(text, sizeof text, format, a, b);
  return velkcore::UTF8to16(text);
}

// How one arrangement view placed its first `count` children: on how many lines and in how
// many columns (distinct tops and lefts).
struct Flow {
  int lines = 0;
  int columns = 0;
};

Flow ReadFlow(const ui::UI_Node& view, std::size_t count) {
  std::set<float> tops;
  std::set<float> lefts;
  for (std::size_t i = 0; i < count && i < view.ChildSize(); ++i) {
    const RectT<float> frame = view.ChildGet(i)->UI_GetLocalRectF(true);
    tops.insert(frame.top);
    lefts.insert(frame.left);
  }
  return {static_cast<int>(tops.size()), static_cast<int>(lefts.size())};
}

// One look at the window: its pixels with the decoration, and what the views did.
struct Shot {
  boost::intrusive_ptr<pictel::ImageInterface> screen;
  RectT<float> frame;
  RectT<std::int32_t> client;
  Flow cards;
  Flow tools;
};

constexpr std::size_t kCardCount = 3;
constexpr std::size_t kToolCount = 10;

Shot TakeShot(ui::HeadlessPlatform& headless, ui::OS_Window& window, const LayoutPanel& panel) {
  headless.ProcessEvents();
  const ui::PlatformWindow handle = window.GetPlatformWindow(false);
  const RectT<std::int32_t> frame = headless.GetFrameRect(handle);
  return {headless.RenderScreen(),
          {static_cast<float>(frame.left), static_cast<float>(frame.top),
           static_cast<float>(frame.width), static_cast<float>(frame.height)},
          headless.GetClientRect(handle),
          ReadFlow(*panel.Cards(), kCardCount),
          ReadFlow(*panel.Tools(), kToolCount)};
}

std::u16string DescribeCards(const Flow& flow) {
  if (flow.lines == 1) return Text("cards: a row of %d", flow.columns);
  if (flow.columns == 1) return Text("cards: a column of %d", flow.lines);
  return Text("cards: %d lines of up to %d", flow.lines, flow.columns);
}

std::u16string DescribeTools(const Flow& flow) {
  if (flow.lines == 1) return Text("tools: %d tiles on one line", flow.columns);
  return Text("tools: %d lines of up to %d", flow.lines, flow.columns);
}

std::u16string DescribeSize(const Shot& shot) {
  return Text("%d \u00D7 %d", shot.client.width, shot.client.height);
}

void DrawWindowShot(Painter& p, const Shot& shot, PointT<float> at) {
  p.Shadow({at.x, at.y, shot.frame.width, shot.frame.height});
  p.Crop(*shot.screen, shot.frame, at);
}

// A title, the client size and what the two views did, one per line.
void DrawCaption(Painter& p, const Shot& shot, PointT<float> at, const char16_t* title) {
  p.Text(title, at, kInk, 15, true);
  p.Text(u"client area " + DescribeSize(shot), {at.x, at.y + 22}, kMutedInk, 12);
  p.Text(DescribeCards(shot.cards), {at.x, at.y + 40}, kMutedInk, 12);
  p.Text(DescribeTools(shot.tools), {at.x, at.y + 58}, kMutedInk, 12);
}

// The arrow between the two screens: what happened in between.
void DrawResizeArrow(Painter& p, float left, float right, float y, const Shot& from,
                     const Shot& to) {
  p.Line({left, y}, {right - 12, y}, kAccent, 3);
  p.Polygon({{right - 14, y - 9}, {right, y}, {right - 14, y + 9}}, kAccent);
  const float middle = (left + right) / 2;
  p.Text(u"user resize", {middle, y - 14}, kAccent, 12, true, TextAlignment::kCenter);
  p.Text(DescribeSize(from), {middle, y + 24}, kMutedInk, 11, false, TextAlignment::kCenter);
  p.Text(u"\u2193", {middle, y + 40}, kMutedInk, 11, false, TextAlignment::kCenter);
  p.Text(DescribeSize(to), {middle, y + 56}, kMutedInk, 11, false, TextAlignment::kCenter);
}

// The pointer of a user dragging the window's bottom-right corner.
void DrawSizingPointer(Painter& p, PointT<float> at) {
  const auto arrow = [&](float grow, const ColorRGBA& color) {
    const float head = 6 + grow;
    const float reach = 9 + grow * 0.5f;
    p.Line({at.x - reach + 3, at.y - reach + 3}, {at.x + reach - 3, at.y + reach - 3}, color,
           2 + 2 * grow);
    p.Polygon({{at.x - reach - grow, at.y - reach - grow},
               {at.x - reach + head, at.y - reach - grow},
               {at.x - reach - grow, at.y - reach + head}},
              color);
    p.Polygon({{at.x + reach + grow, at.y + reach + grow},
               {at.x + reach - head, at.y + reach + grow},
               {at.x + reach + grow, at.y + reach - head}},
              color);
  };
  arrow(1.2f, {1, 1, 1, 1});
  arrow(0, {0.05f, 0.05f, 0.08f, 1});
}

void DrawNotes(Painter& p, const RectT<float>& card) {
  p.FillRound({card.left + 2, card.top + 4, card.width, card.height}, 10, {0, 0, 0, 0.10f});
  p.FillRound(card, 10, {1, 1, 1, 0.96f});
  p.Text(u"How the resize travelled", {card.left + 22, card.top + 34}, kInk, 15, true);
  const std::vector<std::u16string> lines = {
      u"The user drags the frame: the window manager sends the window its size message, as "
      u"it would on any backend.",
      u"The window's root node follows its edge bindings, and the panel's content view with it.",
      u"The flipping view picks the candidate that fits the new size, a row or a column of "
      u"cards; its dividers turn with it.",
      u"The wrapping view breaks its tiles into as many lines as the width needs. Nothing is "
      u"placed by hand: both pictures show the same nodes."};
  float y = card.top + 54;
  for (const std::u16string& line : lines) {
    p.FillRound({card.left + 24, y + 7, 7, 7}, 3.5f, kAccent);
    y += p.Paragraph(line, {card.left + 42, y}, card.width - 66, kMutedInk, 12) + 10;
  }
}

boost::intrusive_ptr<pictel::ImageInterface> RenderLayoutPage() {
  ui::HeadlessPlatform& headless = ui::HeadlessPlatform::Get();
  headless.SetMonitors(
      {{{0, 0, kPageWidth, kPageHeight}, {0, 0, kPageWidth, kPageHeight}, 1, true}});
  Shot wide;
  Shot narrow;
  {
    LayoutPanel panel(static_cast<float>(kWideClient.width),
                      static_cast<float>(kWideClient.height));
    const auto window = velkcore::MakeIntrusive<ui::OS_Window>(
        u"Layout \u2014 reflowing panel", kWideClient, ui::kStyleOverlappedWindow);
    const ui::PlatformWindow handle = window->GetPlatformWindow(false);
    // The frame given was the outer one: make the client area the wanted size.
    window->UI_SetLocalRect(kWideClient);
    window->ChildPushBack(panel.Root());
    window->UI_Show(true);
    wide = TakeShot(headless, *window, panel);

    headless.UserSetClientRect(handle, kNarrowClient);
    narrow = TakeShot(headless, *window, panel);
  }
  headless.ProcessEvents();

  const auto supplier = pictel::NewOSSupplier();
  const auto surface = supplier->NewSurface(kPageWidth, kPageHeight, false);
  Painter p(*supplier, *surface);
  p.Gradient({0, 0, kPageWidth, kPageHeight}, {0.87f, 0.89f, 0.93f, 1}, {0.78f, 0.81f, 0.87f, 1});
  p.Text(u"Arrangement views reflow with their window", {48, 62}, kInk, 24, true);
  p.Paragraph(
      u"One panel in a resizable window on the headless window system, before and after the "
      u"user drags its frame: a flipping view of three cards and a wrapping view of tool tiles.",
      {48, 78}, 760, kMutedInk, 13);

  DrawWindowShot(p, wide, kWideAt);
  DrawCaption(p, wide, {kWideAt.x, kWideAt.y + wide.frame.height + 34}, u"Wide");
  DrawWindowShot(p, narrow, kNarrowAt);
  DrawSizingPointer(p,
                    {kNarrowAt.x + narrow.frame.width - 4, kNarrowAt.y + narrow.frame.height - 4});
  DrawCaption(p, narrow, {kNarrowAt.x + narrow.frame.width + 30, kNarrowAt.y + 24}, u"Narrow");
  DrawResizeArrow(p, kWideAt.x + wide.frame.width + 28, kNarrowAt.x - 28,
                  kWideAt.y + wide.frame.height / 2, wide, narrow);
  const float notesTop = kWideAt.y + wide.frame.height + 124;
  DrawNotes(p, {kWideAt.x, notesTop, wide.frame.width, 196});
  surface->Flush();
  return surface->GetSurfaceImage();
}

const PageRegistration kLayoutPage{{"layout", 20, &RenderLayoutPage}};

}  // namespace
}  // namespace gallery
