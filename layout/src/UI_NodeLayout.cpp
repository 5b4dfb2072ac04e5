#include <velkui/layout/UI_NodeLayout.h>

#include <algorithm>
#include <cmath>
#include <utility>

#include <velkcore/Error.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>

namespace velkui::layout {

UI_NodeLayout::UI_NodeLayout(ui::NodeP node, const PointF& size) : SmartLayout(size) {
  SetNode(std::move(node));
}

UI_NodeLayout::~UI_NodeLayout() = default;

void UI_NodeLayout::SetLocation(const RectF& rect) {
  node_->UI_SetLocalRectF(rect);
}

void UI_NodeLayout::SetNode(ui::NodeP node) {
  velkcore::RequireInput(node != nullptr);
  node_ = std::move(node);
}

PointF UI_NodeLayout::MeasureRecommendedSize(ui::UI_Node& node,
                                             const pictel::SupplierInterface* supplier) {
  velkcore::RequireInput(supplier != nullptr);
  const auto surface = supplier->NewSurface(1, 1, true);
  pictel::Pictel context(supplier, surface.get());
  return node.UI_GetRecommendedSize(&context);
}

void UI_NodeLayout::GrowInitialSizeToFit(const PointF& needed) {
  const PointF current = GetStoredSize();
  SetInitialSize(
      {std::ceil(std::max(current.x, needed.x)), std::ceil(std::max(current.y, needed.y))});
}

}  // namespace velkui::layout
