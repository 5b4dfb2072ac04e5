#pragma once

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>

namespace velkui::layout {

using PointF = velkcore::PointT<float>;
using RectF = velkcore::RectT<float>;

// One element of a composed layout: it has an initial (wanted) size and, once the whole
// composition is given a rectangle, receives its own rectangle through SetLocation.
class SmartLayout : public velkcore::RefCountedObject {
 public:
  // Raises the contract violation for a size that is negative or not finite.
  explicit SmartLayout(const PointF& initialSize);
  ~SmartLayout() override;

  virtual void SetLocation(const RectF& rect) = 0;
  // Default: the stored initial size.
  virtual PointF GetInitialSize() const;

 protected:
  // For elements whose size is only known after construction (a control measured with a
  // drawing context, for instance). The same rules as the constructor.
  void SetInitialSize(const PointF& size);
  const PointF& GetStoredSize() const { return initialSize_; }

 private:
  PointF initialSize_;
};

using SmartLayoutP = boost::intrusive_ptr<SmartLayout>;

// An element of size (0, 0) that places nothing.
class EmptyLayout : public SmartLayout {
 public:
  EmptyLayout();
  void SetLocation(const RectF& rect) override;

  // One instance shared by everyone who needs "nothing here".
  static const SmartLayoutP& GetSharedPtr();
};

}  // namespace velkui::layout
