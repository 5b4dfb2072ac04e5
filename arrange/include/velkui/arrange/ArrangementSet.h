#pragma once

#include <cstddef>
#include <vector>

#include <velkui/arrange/IArrangement.h>

namespace velkui::arrange::impl {

// The candidates of one arrangeable, in the order they were added, with no candidate covered by
// another (smaller or equal in both minimum dimensions).
class ArrangementSet {
 public:
  // Ignores null; drops `a` when an earlier candidate covers it and it does not cover that one;
  // otherwise removes every candidate `a` covers and appends it (of two candidates with the
  // same minimum size the later one stays).
  void AddArrangement(const IArrangementP& a);
  // Whether AddArrangement would drop a candidate of this minimum size; lets builders skip
  // constructing candidates that could not survive.
  bool WouldDrop(float minWidth, float minHeight) const;
  void Clear();

  bool Empty() const { return candidates_.empty(); }
  std::size_t Size() const { return candidates_.size(); }
  const IArrangementP& operator[](std::size_t i) const { return candidates_[i]; }
  std::vector<IArrangementP>::const_iterator begin() const { return candidates_.begin(); }
  std::vector<IArrangementP>::const_iterator end() const { return candidates_.end(); }

  // The candidate that suits `size` best, or null for an empty set: fitting candidates beat
  // overflowing ones; among fitting ones the least waste, then the smallest minimum area wins;
  // among overflowing ones the least overflow; ties keep the earlier candidate.
  IArrangement* ChooseFor(const PointF& size) const;
  // Minimum size of the candidate whose best proportions are closest to the golden ratio;
  // (0, 0) for an empty set.
  PointF BestSize() const;

 private:
  struct MinSize {
    float width;
    float height;
  };
  // Index of the first candidate that covers or is covered by a candidate of this size.
  std::ptrdiff_t FirstComparable(float minWidth, float minHeight) const;

  std::vector<IArrangementP> candidates_;
  std::vector<MinSize> minSizes_;  // kept beside the candidates for fast dominance tests
};

}  // namespace velkui::arrange::impl
