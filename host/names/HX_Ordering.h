// Orders data types and variables: definitions before their uses.
//
//   std::vector<const HX_TypeItem*> types = HX_OrderTypes(model);

#ifndef HOST_NAMES_HX_ORDERING_H
#define HOST_NAMES_HX_ORDERING_H

#include <deque>
#include <vector>

#include "host/model/HX_Model.h"
#include "host/names/HX_FormedName.h"

/// A type depends on the element type, the type under a derived type, and the
/// types of fields; a variable depends on the variables in `dependsOn`. Items
/// without any dependency come last: the widest first, equal widths by name.
/// The order of the document has no influence.
///
/// The library reports a circle (message 403), with the items of the circle
/// alone; the result is then empty.
std::vector<const HX_TypeItem*> HX_OrderTypes(const HX_Model& model);
/// The defined variables among \p names.
std::vector<const HX_FormedName*> HX_OrderVariables(
    const HX_Model& model, const std::deque<HX_FormedName>& names);
/// The defined variables among \p names, which belong to one component.
/// Dependencies on variables of other components do not count.
/// \param count  number of names of the model
std::vector<const HX_FormedName*> HX_OrderVariables(
    const std::vector<const HX_FormedName*>& names, std::size_t count);

#endif  // HOST_NAMES_HX_ORDERING_H
