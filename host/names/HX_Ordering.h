// Orders data types and variables so that each comes after those it depends
// on.
//
//   std::vector<const HX_TypeItem*> types = HX_OrderTypes(model);

#ifndef HOST_NAMES_HX_ORDERING_H
#define HOST_NAMES_HX_ORDERING_H

#include <vector>

#include "host/model/HX_Model.h"

/// A type depends on its element type, the type it is derived from and the
/// types of its fields; a variable on those that the document names. What
/// depends on nothing and nothing depends on comes last: the widest first, the
/// same width by name. The order does not depend on that of the document.
///
/// A cycle is reported to the message handler (message 403); the result is then
/// empty.
std::vector<const HX_TypeItem*> HX_OrderTypes(const HX_Model& model);
/// The variables that are defined.
std::vector<const HX_Name*> HX_OrderVariables(const HX_Model& model);

#endif  // HOST_NAMES_HX_ORDERING_H
