#include <velkui/layout/LayoutDecorator.h>

#include <utility>

#include <velkcore/Error.h>

namespace velkui::layout {

namespace {

bool PartContains(const SmartLayout* part, const SmartLayout* element) {
  if (part == nullptr) return false;
  if (part == element) return true;
  const auto* decorator = dynamic_cast<const LayoutDecorator*>(part);
  return decorator != nullptr && decorator->Contains(element);
}

}  // namespace

LayoutDecorator::LayoutDecorator(const PointF& initialSize, SmartLayoutP decorated)
    : SmartLayout(initialSize) {
  RequireAcyclicPart(decorated.get());
  decorated_ = std::move(decorated);
}

LayoutDecorator::~LayoutDecorator() = default;

void LayoutDecorator::SetLocation(const RectF& rect) {
  decorated_->SetLocation(rect);
}

PointF LayoutDecorator::GetInitialSize() const {
  return decorated_->GetInitialSize();
}

const SmartLayoutP& LayoutDecorator::GetDecoratedObject() const {
  return decorated_;
}

void LayoutDecorator::SetDecoratedObject(SmartLayoutP decorated) {
  RequireAcyclicPart(decorated.get());
  decorated_ = std::move(decorated);
}

void LayoutDecorator::InsertLayoutDecorator(LayoutDecoratorP decorator) {
  velkcore::RequireInput(decorator != nullptr && decorator.get() != this &&
                         !Contains(decorator.get()));
  // Checked before anything changes: the inserted decorator's other parts must not lead back
  // here either.
  velkcore::RequireInput(!PartContains(decorator->GetOtherPart(), this));
  decorator->decorated_ = decorated_;
  decorated_ = std::move(decorator);
}

bool LayoutDecorator::Contains(const SmartLayout* element) const {
  if (element == this) return true;
  return PartContains(decorated_.get(), element) || PartContains(GetOtherPart(), element);
}

void LayoutDecorator::RequireAcyclicPart(const SmartLayout* part) const {
  velkcore::RequireInput(part != nullptr && !PartContains(part, this));
}

}  // namespace velkui::layout
