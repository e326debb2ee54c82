// Orders data types and variables so that each comes after those it depends
// on.
//
//   std::vector<const HX_TypeItem*> types;
//   if (!HX_OrderTypes(model, types)) return 1;   // a cycle, reported

#ifndef HOST_HX_ORDERING_H
#define HOST_HX_ORDERING_H

#include <vector>

#include "host/HX_NameRun.h"

/// A type depends on its element type, the type it is derived from and the
/// types of its fields; a variable on those that the document names. What
/// depends on nothing and nothing depends on comes last: the widest first, the
/// same width by name. The order does not depend on that of the document.
///
/// \return false for a cycle, which message 403 has reported to the message
///   handler; the result is then empty
bool HX_OrderTypes(const HX_Model& model,
                   std::vector<const HX_TypeItem*>& ordered);
/// The variables among \p names that are defined.
bool HX_OrderVariables(const std::vector<HX_FormedName>& names,
                       std::vector<const HX_FormedName*>& ordered);

#endif  // HOST_HX_ORDERING_H
