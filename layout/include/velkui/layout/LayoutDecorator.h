#pragma once

#include <velkui/layout/SmartLayout.h>

namespace velkui::layout {

class LayoutDecorator;
using LayoutDecoratorP = boost::intrusive_ptr<LayoutDecorator>;

// An element wrapped around another one (the decorated object). By default it adds nothing:
// its initial size and its placement are the decorated object's.
//
// The decorated object is never null, and a decorator is never (directly or through other
// decorators and joiners) part of its own decorated object: both raise the contract violation.
class LayoutDecorator : public SmartLayout {
 public:
  LayoutDecorator(const PointF& initialSize, SmartLayoutP decorated);
  ~LayoutDecorator() override;

  void SetLocation(const RectF& rect) override;
  PointF GetInitialSize() const override;

  virtual const SmartLayoutP& GetDecoratedObject() const;
  virtual void SetDecoratedObject(SmartLayoutP decorated);
  // Inserts `decorator` just below this one: it takes over this decorator's decorated object
  // and becomes this decorator's decorated object.
  virtual void InsertLayoutDecorator(LayoutDecoratorP decorator);

  // Whether `element` is this element or lies anywhere below it.
  bool Contains(const SmartLayout* element) const;

 protected:
  // Elements other than the decorated object that this element places (a joiner's own
  // element); used by Contains.
  virtual const SmartLayout* GetOtherPart() const { return nullptr; }
  // Raises the contract violation unless `part` is non-null and does not contain this element.
  void RequireAcyclicPart(const SmartLayout* part) const;

 private:
  SmartLayoutP decorated_;
};

}  // namespace velkui::layout
