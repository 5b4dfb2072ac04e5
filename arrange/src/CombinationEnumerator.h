#pragma once

#include <cstddef>
#include <functional>
#include <vector>

#include <velkui/arrange/AbstractArrangeableGroup.h>

namespace velkui::arrange::impl {

// Walks the combinations of a group's child candidates (one candidate per child; children
// without candidates left out) and hands each to the group's builder.
//
// Small products are enumerated completely, child by child in order with the last child varying
// fastest. When the product would cost more than a fixed budget of work, only the combinations
// that are best for a common size limit are built: for a limit t on the height, every child
// takes its narrowest candidate no taller than t (or its shortest if none is), and likewise for
// limits on the width. These include every combination whose row or column is not covered by
// another, so rows, columns and flipping groups keep exactly the same minimum sizes; wrapping
// groups keep good candidates among the rest. The number of limits is capped by the same
// budget, so a group's rebuild costs at most that budget whatever the depth of the tree.
class CombinationEnumerator {
 public:
  using Visit = std::function<void(const AbstractArrangeableGroup::Combination&)>;

  // Work allowed per rebuild, counted in child candidates visited by the builders.
  static constexpr std::size_t kWorkBudget = 16384;

  explicit CombinationEnumerator(AbstractArrangeableGroup& group);
  void Run(const Visit& visit);

  // Whether the last Run enumerated every combination.
  bool WasExhaustive() const { return exhaustive_; }

 private:
  struct ChildCandidates {
    const ArrangementSet* set;
    // Candidate indices sorted by minimum height (by minimum width), and for each prefix the
    // index of the narrowest (shortest) candidate in it.
    std::vector<std::size_t> byHeight;
    std::vector<std::size_t> narrowestUpTo;
    std::vector<std::size_t> byWidth;
    std::vector<std::size_t> shortestUpTo;
  };

  void EnumerateAll(const Visit& visit);
  void EnumerateByLimits(std::size_t combinationBudget, const Visit& visit);
  void PrepareLimits();
  void VisitLimits(bool limitHeight, std::size_t count, std::vector<std::size_t>& previous,
                   const Visit& visit);
  std::size_t PickFor(const ChildCandidates& child, bool limitHeight, float limit) const;

  AbstractArrangeableGroup& group_;
  std::vector<ChildCandidates> children_;
  AbstractArrangeableGroup::Combination combination_;
  bool exhaustive_ = true;
};

}  // namespace velkui::arrange::impl
