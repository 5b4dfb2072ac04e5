#include <velkui/arrange/Single.h>

#include "SingleArrangement.h"

namespace velkui::arrange {

Single::Single(IArrangeable* parent) : IArrangeable(parent) {}

Single::~Single() {
  for (const impl::IArrangementP& a : arrangements_) {
    static_cast<impl::SingleArrangement*>(a.get())->DetachLeaf();
  }
}

void Single::RebuildSelf() {
  for (const impl::IArrangementP& a : arrangements_) {
    static_cast<impl::SingleArrangement*>(a.get())->DetachLeaf();
  }
  arrangements_.Clear();
  arrangements_.AddArrangement(new impl::SingleArrangement(*this));
}

}  // namespace velkui::arrange
