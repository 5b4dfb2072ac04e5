#pragma once

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>

namespace velkui::layout {

// Decides who takes the space left over when a decorator's own element and its decorated
// object are both given their wanted size side by side. The first argument is always the own
// element, the second the decorated object; each rule only ever widens (or heightens) one of
// them until it meets the other.
//
// Horizontally the two stay 1 unit apart; vertically they meet edge to edge.
class ExtraSpaceAlgorithm : public velkcore::RefCountedObject {
 public:
  ~ExtraSpaceAlgorithm() override;
  virtual void AdjustRectsVertically(velkcore::RectT<float>& own,
                                     velkcore::RectT<float>& decorated) const = 0;
  virtual void AdjustRectsHorizontally(velkcore::RectT<float>& own,
                                       velkcore::RectT<float>& decorated) const = 0;
};

using ExtraSpaceAlgorithmP = boost::intrusive_ptr<const ExtraSpaceAlgorithm>;

// The own element takes the extra space.
class ExtraSpace_Keep : public ExtraSpaceAlgorithm {
 public:
  void AdjustRectsVertically(velkcore::RectT<float>& own,
                             velkcore::RectT<float>& decorated) const override;
  void AdjustRectsHorizontally(velkcore::RectT<float>& own,
                               velkcore::RectT<float>& decorated) const override;
  static const ExtraSpaceAlgorithmP& GetSharedPtr();
};

// The decorated object takes the extra space.
class ExtraSpace_Pass : public ExtraSpaceAlgorithm {
 public:
  void AdjustRectsVertically(velkcore::RectT<float>& own,
                             velkcore::RectT<float>& decorated) const override;
  void AdjustRectsHorizontally(velkcore::RectT<float>& own,
                               velkcore::RectT<float>& decorated) const override;
  static const ExtraSpaceAlgorithmP& GetSharedPtr();
};

}  // namespace velkui::layout
