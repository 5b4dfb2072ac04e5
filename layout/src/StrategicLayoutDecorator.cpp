#include <velkui/layout/StrategicLayoutDecorator.h>

#include <utility>

#include <velkcore/Error.h>

namespace velkui::layout {

StrategicLayoutDecorator::StrategicLayoutDecorator(const PointF& ownSize, SmartLayoutP decorated,
                                                   LayoutPlacementAlgorithmP placement,
                                                   ExtraSpaceAlgorithmP extraSpace)
    : LayoutDecorator(ownSize, std::move(decorated)) {
  SetPlacementAlgorithm(std::move(placement));
  SetExtraSpaceAlgorithm(std::move(extraSpace));
}

StrategicLayoutDecorator::~StrategicLayoutDecorator() = default;

PointF StrategicLayoutDecorator::GetOwnSize() const {
  return GetStoredSize();
}

PointF StrategicLayoutDecorator::GetInitialSize() const {
  return placement_->GetCombinedSize(GetOwnSize(), GetDecoratedObject()->GetInitialSize());
}

void StrategicLayoutDecorator::SetLocation(const RectF& area) {
  RectF own{};
  RectF decorated{};
  placement_->GetRects(area, GetOwnSize(), GetDecoratedObject()->GetInitialSize(), own, decorated,
                       extraSpace_);
  ownRect_ = own;
  GetDecoratedObject()->SetLocation(decorated);
}

void StrategicLayoutDecorator::SetPlacementAlgorithm(LayoutPlacementAlgorithmP placement) {
  velkcore::RequireInput(placement != nullptr);
  placement_ = std::move(placement);
}

void StrategicLayoutDecorator::SetExtraSpaceAlgorithm(ExtraSpaceAlgorithmP extraSpace) {
  velkcore::RequireInput(extraSpace != nullptr);
  extraSpace_ = std::move(extraSpace);
}

}  // namespace velkui::layout
