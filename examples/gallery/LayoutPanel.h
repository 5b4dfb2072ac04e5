#pragma once

#include <velkui/pictel/Pictel.h>
#include <velkui/ui/UI_ArrangementView.h>
#include <velkui/ui/UI_SubView.h>

namespace gallery {

// A resizable panel that shows arrangement views reflowing: three cards in a flipping view (a
// row when the panel is wide, a column when it is narrow), with dividers between them, and a
// strip of tool tiles in a horizontally wrapping view, stacked in a column. The dividers draw
// with the theme's colours: the theme must be installed before the panel is drawn.
//
// The panel's root follows its parent's size through its edge bindings (right and bottom), so
// a window whose root node lays out its children only has to hold it; Resize sets its size
// directly.
class LayoutPanel {
 public:
  LayoutPanel(float width, float height);

  const velkui::ui::SubViewP& Root() const { return root_; }
  void Resize(float width, float height);
  // Paints the panel with its background, from its root.
  void Draw(velkui::pictel::Pictel& context) const;

  const velkui::ui::ArrangementViewP& Cards() const { return cards_; }
  const velkui::ui::ArrangementViewP& Tools() const { return tools_; }

 private:
  velkui::ui::SubViewP root_;
  velkui::ui::ArrangementViewP content_;
  velkui::ui::ArrangementViewP cards_;
  velkui::ui::ArrangementViewP tools_;
};

}  // namespace gallery
