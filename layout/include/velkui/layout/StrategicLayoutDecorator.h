#pragma once

#include <velkui/layout/ExtraSpaceAlgorithm.h>
#include <velkui/layout/LayoutDecorator.h>
#include <velkui/layout/LayoutPlacementAlgorithm.h>

namespace velkui::layout {

// A decorator that puts an element of its own beside the decorated object: the placement
// algorithm says on which side, the extra-space algorithm who takes any space left over.
// Its initial size is the own element's size.
class StrategicLayoutDecorator : public LayoutDecorator {
 public:
  // Null algorithms raise the contract violation.
  StrategicLayoutDecorator(const PointF& ownSize, SmartLayoutP decorated,
                           LayoutPlacementAlgorithmP placement, ExtraSpaceAlgorithmP extraSpace);
  ~StrategicLayoutDecorator() override;

  // The placement's combined size of the own element and the decorated object.
  PointF GetInitialSize() const override;
  // Splits `area` with the placement algorithm, keeps the own rectangle and places the
  // decorated object in its rectangle.
  void SetLocation(const RectF& area) override;

  // The own element's rectangle from the last SetLocation (all zero before).
  const RectF& GetOwnRect() const { return ownRect_; }

  const LayoutPlacementAlgorithmP& GetPlacementAlgorithm() const { return placement_; }
  void SetPlacementAlgorithm(LayoutPlacementAlgorithmP placement);
  const ExtraSpaceAlgorithmP& GetExtraSpaceAlgorithm() const { return extraSpace_; }
  void SetExtraSpaceAlgorithm(ExtraSpaceAlgorithmP extraSpace);

 protected:
  // The size of the own element; the stored initial size unless a subclass says otherwise.
  virtual PointF GetOwnSize() const;

 private:
  RectF ownRect_{};
  LayoutPlacementAlgorithmP placement_;
  ExtraSpaceAlgorithmP extraSpace_;
};

}  // namespace velkui::layout
