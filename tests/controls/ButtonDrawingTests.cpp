#include <gtest/gtest.h>

#include <velkui/controls/ControlPalettes.h>
#include <velkui/controls/UI_Checkbox.h>
#include <velkui/controls/UI_DisclosureTriangleButton.h>
#include <velkui/controls/UI_RadioButton.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/test/GoldenImage.h>
#include <velkui/test/PixelProbe.h>

#include "ControlTestSupport.h"

namespace velkui::controls::test {
namespace {

using velkui::test::Pixel;
using velkui::test::PixelProbe;

constexpr float kCell = 44;
constexpr float kFaceWidth = 36;
constexpr float kFaceHeight = 24;

class ButtonDrawingTest : public ControlTest {
 protected:
  boost::intrusive_ptr<pictel::SupplierInterface> supplier = pictel::NewOSSupplier();

  pictel::SurfaceP Canvas(std::int32_t width, std::int32_t height) {
    pictel::SurfaceP surface(*supplier, width, height, false);
    surface->PaintRect(ui::Theme::Get().GetColor(4),
                       {0, 0, static_cast<float>(width), static_cast<float>(height)});
    return surface;
  }

  static DrawButtonParameters Face(ControlState state, float left, float top) {
    DrawButtonParameters p;
    p.SetControlState(state);
    p.SetCornerRadius(4);
    p.SetRectF({left, top, kFaceWidth, kFaceHeight});
    return p;
  }

  // Rows: plain, default appearance, selected appearance, semi-rounded with a
  // rotated gradient; columns: normal, rollover, down, disabled, focus,
  // rollover and down, disabled and down. Then triangle faces and marks.
  void DrawSheet(pictel::SurfaceInterface& surface) {
    pictel::Pictel context(supplier.get(), &surface);
    const std::uint32_t states[] = {0,
                                    kControlStateRollover,
                                    kControlStateDown,
                                    kControlStateDisabled,
                                    kControlStateFocus,
                                    kControlStateRollover | kControlStateDown,
                                    kControlStateDisabled | kControlStateDown};
    for (int row = 0; row < 4; ++row) {
      for (int column = 0; column < 7; ++column) {
        DrawButtonParameters p = Face(states[column], 4 + column * kCell, 4 + row * 32.0f);
        p.SetDefaultAppearance(row == 1);
        p.SetStrokeSize(row == 1 ? 2.0f : 1.0f);
        p.SetSelectedAppearance(row == 2);
        p.SetSemiRounded(row == 3);
        p.SetRotatedGradient(row == 3);
        UI_Button::Draw(p, &context);
      }
    }
    for (int i = 0; i < 4; ++i) {
      const DrawTrianglePicture triangle(30.0f * static_cast<float>(i));
      DrawButtonParameters p = Face(i == 3 ? kControlStateDisabled : 0, 4 + i * kCell, 132);
      p.SetDrawContainer(false);
      p.SetDrawButtonFace(&triangle);
      UI_Button::Draw(p, &context);
    }
    // Check boxes and radio buttons without labels: off, on, mixed, disabled.
    for (int i = 0; i < 4; ++i) {
      auto box = Add<UI_Checkbox>({180 + i * 22.0f, 134, 18, 18});
      auto radio = Add<UI_RadioButton>({180 + i * 22.0f, 158, 18, 18});
      if (i == 1) {
        box->SetChecked(true);
        radio->SetOn(true);
      } else if (i != 2) {
        box->SetChecked(false);
        radio->SetOn(false);
      }
      if (i == 3) {
        box->SetDisabled(true);
        radio->SetDisabled(true);
      }
    }
    root->UI_DispatchDrawFromRoot({0, 0, 0, 0}, &context, true);
  }
};

TEST_F(ButtonDrawingTest, ButtonFacesInTheLightColours) {
  const pictel::SurfaceP surface = Canvas(312, 182);
  DrawSheet(*surface);
  EXPECT_TRUE(velkui::test::MatchesGolden(*surface->GetSurfaceImage(),
                                          VELKUI_TEST_DATA_DIR "/golden", "button_faces_light",
                                          {2, 0.002}));
}

TEST_F(ButtonDrawingTest, ButtonFacesInTheDarkColours) {
  ApplyDarkControlColors(ui::Theme::Get());
  const pictel::SurfaceP surface = Canvas(312, 182);
  DrawSheet(*surface);
  EXPECT_TRUE(velkui::test::MatchesGolden(*surface->GetSurfaceImage(),
                                          VELKUI_TEST_DATA_DIR "/golden", "button_faces_dark",
                                          {2, 0.002}));
}

TEST_F(ButtonDrawingTest, TheFocusRingIsDrawnInTheAccentAroundTheBody) {
  const pictel::SurfaceP surface = Canvas(60, 40);
  pictel::Pictel context(supplier.get(), surface.Get());
  UI_Button::Draw(Face(kControlStateFocus, 10, 8), &context);
  const PixelProbe probe(*surface);
  const Pixel frame = probe.At(11, 20);  // the body's edge
  const pictel::ColorRGBA accent = ui::Theme::Get().GetColor(18);
  EXPECT_NEAR(frame.blue, accent.blue * 255, 3);
  EXPECT_NEAR(frame.red, accent.red * 255, 3);
  const Pixel halo = probe.At(10, 20);  // the halo outside it, half strength
  EXPECT_GT(halo.blue, halo.red);
  EXPECT_GT(halo.red, frame.red);
}

TEST_F(ButtonDrawingTest, ColoursPassThroughTheColourChangeMap) {
  const pictel::SurfaceP surface = Canvas(60, 40);
  pictel::Pictel context(supplier.get(), surface.Get());
  ColorChangeMap map{{20, 242}, {21, 242}, {0, 13}};
  DrawButtonParameters p = Face(0, 10, 8);
  p.SetColorChangeMap(&map);
  UI_Button::Draw(p, &context);
  const Pixel centre = PixelProbe(*surface).At(28, 26);
  const pictel::ColorRGBA red = ui::Theme::Get().GetColor(242);
  EXPECT_NEAR(centre.red, red.red * 255, 3);
  EXPECT_NEAR(centre.green, red.green * 255, 3);
}

TEST_F(ButtonDrawingTest, ADisabledFaceUsesTheDisabledColoursAndNoSheen) {
  const pictel::SurfaceP surface = Canvas(60, 40);
  pictel::Pictel context(supplier.get(), surface.Get());
  UI_Button::Draw(Face(kControlStateDisabled, 10, 8), &context);
  const PixelProbe probe(*surface);
  const ui::Theme& theme = ui::Theme::Get();
  const float expected = (theme.GetColor(26).red + theme.GetColor(27).red) / 2 * 255;
  EXPECT_NEAR(probe.At(28, 20).red, expected, 4);
  EXPECT_NEAR(probe.At(28, 10).red, theme.GetColor(26).red * 255, 3) << "no bright first line";
}

TEST_F(ButtonDrawingTest, NothingIsDrawnWhenTheRectangleIsNoWiderThanTheStroke) {
  const pictel::SurfaceP surface(*supplier, 20, 20, true);
  pictel::Pictel context(supplier.get(), surface.Get());
  DrawButtonParameters p = Face(kControlStateFocus, 2, 2);
  p.SetRectF({2, 2, 1, 10});
  UI_Button::Draw(p, &context);
  p.SetRectF({2, 2, 10, 0.5f});
  UI_Button::Draw(p, &context);
  EXPECT_EQ(PixelProbe(*surface).CountVisible(), 0);
}

}  // namespace
}  // namespace velkui::controls::test
