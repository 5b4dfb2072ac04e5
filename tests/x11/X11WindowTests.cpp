#include <cstdlib>
#include <string>

#include <velkcore/Error.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/ui/OS_MessagePump.h>

#include "X11TestSupport.h"

namespace velkui::ui::x11test {
namespace {

constexpr pictel::ColorRGBA kRed{0.8f, 0.2f, 0.2f, 1};
constexpr pictel::ColorRGBA kBlue{0.2f, 0.2f, 0.8f, 1};
constexpr pictel::ColorRGBA kGreen{0.2f, 0.6f, 0.2f, 1};

using X11WindowTest = X11Test;

TEST_F(X11WindowTest, AClickRepaintsTheClickedNodeAndTheServerShowsIt) {
  OS_WindowP window = MakeWindow({120, 100, 300, 200});
  RecordingViewP view = AddView(*window, {20, 30, 100, 60}, kRed);
  view->onMouse = [&view](const MouseEvent& event) {
    if (event.GetAction() == MouseEvent::kButtonDown) {
      view->color = kBlue;
      view->UI_Invalidate(nullptr, {});
    }
  };
  const PlatformWindow handle = Handle(*window);
  ASSERT_TRUE(PumpUntil([&] { return ShownPixel(*window, 70, 60) == PixelOf(kRed); }));
  EXPECT_EQ(ShownPixel(*window, 5, 5), PixelOf({1, 1, 1, 1}));

  const std::int32_t paintsBefore = x11.GetPaintCount(handle);
  Click(*window, 70, 60);
  ASSERT_TRUE(PumpUntil([&] { return ShownPixel(*window, 70, 60) == PixelOf(kBlue); }));
  ASSERT_EQ(view->order, (std::vector<std::string>{"down", "up"}));
  EXPECT_EQ(view->MouseOf(MouseEvent::kButtonDown)[0].GetPosition(), (PointT<float>{50, 30}));
  // Only the node was repainted, in one paint.
  EXPECT_EQ(x11.GetPaintCount(handle), paintsBefore + 1);
  EXPECT_EQ(ShownPixel(*window, 5, 5), PixelOf({1, 1, 1, 1}));
}

TEST_F(X11WindowTest, InvalidationsAccumulateIntoOnePaintPerTurn) {
  OS_WindowP window = MakeWindow({50, 50, 200, 150});
  const PlatformWindow handle = Handle(*window);
  const std::int32_t before = x11.GetPaintCount(handle);
  const RectT<std::int32_t> a{0, 0, 10, 10};
  const RectT<std::int32_t> b{50, 50, 20, 20};
  x11.InvalidateRect(handle, &a);
  x11.InvalidateRect(handle, &b);
  x11.InvalidateRect(handle, &a);
  OS_Event event;
  ASSERT_TRUE(x11.GetNextEvent(event, false));
  EXPECT_EQ(event.GetMsg(), static_cast<std::uint32_t>(kMsgPaint));
  const std::optional<PaintTarget> target = x11.BeginPaint(handle);
  ASSERT_TRUE(target.has_value());
  EXPECT_EQ(target->rects.size(), 2u);
  EXPECT_EQ(target->bounds, (RectT<std::int32_t>{0, 0, 70, 70}));
  x11.EndPaint(handle, *target);
  EXPECT_FALSE(x11.HasPendingPaint(handle));
  EXPECT_FALSE(x11.GetNextEvent(event, false));
  EXPECT_EQ(x11.GetPaintCount(handle), before + 1);
}

TEST_F(X11WindowTest, AnExposedAreaComesBackFromTheBackBufferWithoutARepaint) {
  OS_WindowP window = MakeWindow({200, 200, 160, 120});
  AddView(*window, {0, 0, 160, 120}, kGreen);
  const PlatformWindow handle = Handle(*window);
  ASSERT_TRUE(PumpUntil([&] { return ShownPixel(*window, 80, 60) == PixelOf(kGreen); }));
  const std::int32_t paints = x11.GetPaintCount(handle);
  // Another window covers it and goes away again.
  OS_WindowP cover = MakeWindow({180, 180, 120, 100});
  cover->UI_Show(false);
  PumpFor(0.2);
  EXPECT_EQ(ShownPixel(*window, 40, 30), PixelOf(kGreen));
  EXPECT_EQ(x11.GetPaintCount(handle), paints);
}

TEST_F(X11WindowTest, AResizeFromOutsideReachesTheWindowAndItsLayoutBinding) {
  OS_WindowP window = MakeWindow({100, 100, 300, 200});
  RecordingViewP pinned = AddView(*window, {200, 150, 80, 30}, kRed);
  pinned->UI_SetLayoutBinding(
      LayoutBinding(kBindLeftToRight | kBindRightToRight | kBindTopToBottom | kBindBottomToBottom));
  RecordingViewP stretched = AddView(*window, {10, 10, 280, 20}, kBlue);
  stretched->UI_SetLayoutBinding(LayoutBinding(kBindRightToRight));

  x11.ResizeFromOutside(Handle(*window), {130, 90, 400, 260});
  ASSERT_TRUE(PumpUntil([&] { return window->UI_GetLocalRect(true).width == 400; }));
  EXPECT_EQ(window->UI_GetLocalRect(true), (RectT<std::int32_t>{130, 90, 400, 260}));
  EXPECT_EQ(x11.GetClientRect(Handle(*window)), (RectT<std::int32_t>{130, 90, 400, 260}));
  EXPECT_EQ(pinned->UI_GetLocalRectF(true), (RectT<float>{300, 210, 80, 30}));
  EXPECT_EQ(stretched->UI_GetLocalRectF(true), (RectT<float>{10, 10, 380, 20}));
  // The new area is painted.
  ASSERT_TRUE(PumpUntil([&] { return ShownPixel(*window, 340, 225) == PixelOf(kRed); }));
  EXPECT_EQ(ShownPixel(*window, 385, 15), PixelOf(kBlue));
}

TEST_F(X11WindowTest, GeometrySettersTakeEffectAtOnceAndTheServerAgrees) {
  OS_WindowP window = MakeWindow({40, 40, 200, 100});
  const PlatformWindow handle = Handle(*window);
  x11.SetClientRect(handle, {60, 70, 220, 110});
  x11.SetClientRect(handle, {80, 90, 240, 120});
  EXPECT_EQ(x11.GetClientRect(handle), (RectT<std::int32_t>{80, 90, 240, 120}));
  // The echoes of both requests come back; neither is taken for a user's change.
  PumpFor(0.3);
  EXPECT_EQ(x11.GetClientRect(handle), (RectT<std::int32_t>{80, 90, 240, 120}));
  // The library's own changes do not come back to the window as a user's.
  EXPECT_EQ(window->UI_GetLocalRect(true), (RectT<std::int32_t>{40, 40, 200, 100}));
  EXPECT_EQ(PixelProbe(*x11.CaptureWindowPixels(handle)).GetWidth(), 240);

  // A child window sits in screen coordinates and follows its parent.
  WindowCreateParams params;
  params.style = kStyleChild | kStyleVisible;
  params.parent = handle;
  params.frame = {100, 100, 50, 40};
  const PlatformWindow child = x11.CreateWindow(params);
  EXPECT_EQ(x11.GetClientRect(child), (RectT<std::int32_t>{100, 100, 50, 40}));
  EXPECT_EQ(x11.GetFrameRect(child), x11.GetClientRect(child));
  x11.SetClientRect(handle, {180, 90, 240, 120});
  EXPECT_EQ(x11.GetClientRect(child), (RectT<std::int32_t>{200, 100, 50, 40}));
  x11.Sync();
  EXPECT_EQ(x11.GetWindowFromPoint({210, 110}), child);
  EXPECT_EQ(x11.GetWindowFromPoint({190, 95}), handle);
  EXPECT_EQ(x11.GetWindowFromPoint({5, 5}), kNoPlatformWindow);
  x11.DestroyWindow(handle);
  EXPECT_FALSE(x11.IsWindow(child));
}

TEST_F(X11WindowTest, ActivationFocusAndHidingFollowTheContract) {
  if (x11.HasWindowManager()) {
    GTEST_SKIP() << "a window manager grants activation and minimising in its own time and by "
                    "its own focus rules";
  }
  OS_WindowP first = MakeWindow({10, 10, 200, 100}, kStyleOverlappedWindow);
  OS_WindowP second = MakeWindow({300, 10, 200, 100}, kStyleOverlappedWindow);
  EXPECT_EQ(x11.GetActiveWindow(), Handle(*second));
  EXPECT_EQ(x11.GetFocus(), Handle(*second));
  x11.ActivateWindow(Handle(*first), false);
  EXPECT_EQ(x11.GetActiveWindow(), Handle(*first));
  PumpFor(0.2);
  // The server's focus events agree, so nothing changes back.
  EXPECT_EQ(x11.GetActiveWindow(), Handle(*first));
  EXPECT_EQ(x11.GetFocus(), Handle(*first));
  // Hiding the active window hands activation to the one before.
  first->UI_Show(false);
  EXPECT_FALSE(x11.IsWindowVisible(Handle(*first)));
  EXPECT_EQ(x11.GetActiveWindow(), Handle(*second));
  PumpFor(0.2);
  EXPECT_EQ(x11.GetActiveWindow(), Handle(*second));

  x11.SetWindowTitle(Handle(*second), u"Mixer \u2014 Bus 1");
  EXPECT_EQ(x11.GetWindowTitle(Handle(*second)), u"Mixer \u2014 Bus 1");
  x11.MinimizeWindow(Handle(*second), true);
  EXPECT_TRUE(x11.IsWindowMinimized(Handle(*second)));
  EXPECT_EQ(x11.GetActiveWindow(), kNoPlatformWindow);
  x11.Sync();
  EXPECT_EQ(x11.GetWindowFromPoint(Screen(*second, 20, 20)), kNoPlatformWindow);
  x11.MinimizeWindow(Handle(*second), false);
  x11.Sync();
  EXPECT_EQ(x11.GetWindowFromPoint(Screen(*second, 20, 20)), Handle(*second));
}

TEST_F(X11WindowTest, UnderAWindowManagerAWindowOpenedAfterAClickBecomesActive) {
  if (!x11.HasWindowManager()) GTEST_SKIP() << "needs a window manager";
  OS_WindowP first = MakeWindow({10, 10, 200, 100}, kStyleOverlappedWindow);
  ASSERT_TRUE(PumpUntil([&] { return x11.GetActiveWindow() == Handle(*first); }));
  Click(*first, 50, 50);
  PumpFor(0.1);
  OS_WindowP second = MakeWindow({300, 10, 200, 100}, kStyleOverlappedWindow);
  EXPECT_TRUE(PumpUntil([&] { return x11.GetActiveWindow() == Handle(*second); }));
  PumpFor(0.3);
  EXPECT_EQ(x11.GetActiveWindow(), Handle(*second));
  EXPECT_EQ(x11.GetFocus(), Handle(*second));
  // Activated again by the program after the user's click: the window manager agrees.
  Click(*second, 50, 50);
  PumpFor(0.1);
  x11.ActivateWindow(Handle(*first), false);
  PumpFor(0.3);
  EXPECT_EQ(x11.GetActiveWindow(), Handle(*first));
  EXPECT_EQ(x11.GetFocus(), Handle(*first));
  // Minimised by the window manager in its own time; the window comes back.
  x11.MinimizeWindow(Handle(*first), true);
  EXPECT_TRUE(PumpUntil([&] { return x11.GetActiveWindow() != Handle(*first); }));
  x11.MinimizeWindow(Handle(*first), false);
  EXPECT_TRUE(PumpUntil([&] {
    x11.Sync();
    return x11.GetWindowFromPoint(Screen(*first, 20, 20)) == Handle(*first);
  }));
}

TEST_F(X11WindowTest, TransparentCornersOfAPopupAreCutOutOfItsShape) {
  WindowCreateParams params;
  params.style = kStylePopup | kStyleVisible;
  params.exStyle = kExStyleNoActivate | kExStyleTopmost;
  params.frame = {400, 300, 60, 40};
  const PlatformWindow popup = x11.CreateWindow(params);
  std::optional<PaintTarget> target = x11.BeginPaint(popup);
  ASSERT_TRUE(target.has_value());
  // A fresh back buffer is transparent: the left half stays so.
  {
    const auto supplier = pictel::NewOSSupplier();
    const auto surface = supplier->NewOSSurface(target->context, nullptr, false);
    surface->PaintRect({0.2f, 0.4f, 0.8f, 1}, {30, 0, 30, 40});
    surface->Flush();
  }
  x11.EndPaint(popup, *target);
  x11.Sync();
  EXPECT_EQ(x11.GetWindowFromPoint({445, 320}), popup);
  EXPECT_EQ(x11.GetWindowFromPoint({410, 320}), kNoPlatformWindow);
  // Pop-ups never take activation.
  EXPECT_NE(x11.GetActiveWindow(), popup);
  const PixelProbe pixels(*x11.CaptureWindowPixels(popup));
  EXPECT_EQ(pixels.At(45, 20), PixelOf({0.2f, 0.4f, 0.8f, 1}));
  x11.DestroyWindow(popup);
}

}  // namespace
}  // namespace velkui::ui::x11test
