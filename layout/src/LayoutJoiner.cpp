#include <velkui/layout/LayoutJoiner.h>

#include <utility>

namespace velkui::layout {

LayoutJoiner::LayoutJoiner(SmartLayoutP element, SmartLayoutP decorated,
                           LayoutPlacementAlgorithmP placement, ExtraSpaceAlgorithmP extraSpace)
    : StrategicLayoutDecorator({0, 0}, std::move(decorated), std::move(placement),
                               std::move(extraSpace)) {
  SetElement(std::move(element));
}

LayoutJoiner::~LayoutJoiner() = default;

PointF LayoutJoiner::GetOwnSize() const {
  return element_->GetInitialSize();
}

void LayoutJoiner::SetLocation(const RectF& area) {
  StrategicLayoutDecorator::SetLocation(area);
  element_->SetLocation(GetOwnRect());
}

void LayoutJoiner::SetElement(SmartLayoutP element) {
  RequireAcyclicPart(element.get());
  element_ = std::move(element);
}

ParentChildLayoutJoiner::ParentChildLayoutJoiner(SmartLayoutP parent, SmartLayoutP child)
    : LayoutJoiner(std::move(parent), std::move(child), LayoutPlacement_LeftOfDO::GetSharedPtr(),
                   ExtraSpace_Keep::GetSharedPtr()) {}

ParentChildLayoutJoiner::~ParentChildLayoutJoiner() = default;

PointF ParentChildLayoutJoiner::GetInitialSize() const {
  const PointF parent = GetElement()->GetInitialSize();
  const PointF child = GetDecoratedObject()->GetInitialSize();
  return {parent.x >= child.x ? parent.x : child.x, parent.y >= child.y ? parent.y : child.y};
}

void ParentChildLayoutJoiner::SetLocation(const RectF& rect) {
  GetElement()->SetLocation(rect);
  GetDecoratedObject()->SetLocation({0, 0, rect.width, rect.height});
}

}  // namespace velkui::layout
