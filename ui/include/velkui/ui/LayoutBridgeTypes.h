#pragma once

#include <cstddef>
#include <cstdint>

// The records of the constraint-layout engine that places nodes through
// measure / measure_vertical / place / get_placement. Only what a node reads
// and writes is defined here; the engine owns everything else.
namespace orvant {

// One axis of a placement: where the content starts, how long it is, and the
// outsets that widen the node's frame beyond the content on either side.
struct place_slice_t {
  std::int32_t position_m = 0;
  std::int32_t length_m = 0;
  std::int32_t outset_leading_m = 0;
  std::int32_t outset_trailing_m = 0;

  friend bool operator==(const place_slice_t&, const place_slice_t&) = default;
};

struct place_data_t {
  place_slice_t horizontal_m;
  place_slice_t vertical_m;

  friend bool operator==(const place_data_t&, const place_data_t&) = default;
};

// One axis of a node's measured extents.
struct extents_slice_t {
  std::int32_t length_m = 0;
  std::int32_t outset_leading_m = 0;
  std::int32_t outset_trailing_m = 0;

  friend bool operator==(const extents_slice_t&, const extents_slice_t&) = default;
};

struct extents_t {
  extents_slice_t horizontal_m;
  extents_slice_t vertical_m;

  friend bool operator==(const extents_t&, const extents_t&) = default;
};

}  // namespace orvant
