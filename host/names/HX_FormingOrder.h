// The order of forming names: early names keep the wanted text.

#ifndef HOST_NAMES_HX_FORMINGORDER_H
#define HOST_NAMES_HX_FORMINGORDER_H

#include <cstddef>
#include <deque>
#include <vector>

struct HX_WantedName;

/// RETURNS: the indices of \p names in the order of the model: interrupt
/// service routines, then tasks, because further names contain the names of
/// tasks; then by path of the source, a block before the blocks inside; then by
/// id. Numbers in paths and ids compare by value: "Gain2" before "Gain10".
/// Names without a source come before names with a source.
/// \param chosen  by index, the names to order; all if empty
/// The order of \p names has no influence.
/// COST: a sort, and the bytes of all paths while the call lasts.
std::vector<std::size_t> HX_FormingOrder(const std::deque<HX_WantedName>& names,
                                         const std::vector<bool>& chosen);

#endif  // HOST_NAMES_HX_FORMINGORDER_H
