// The columns of the table of names, for showing, filtering and sorting.
//
//   HX_SelectNames(names, {"actual=*speed*"}, "source");
//   HX_RowOf(*names[0], {"name", "actual"});   // {"v_set", "speed_set"}

#ifndef HOST_WRITE_HX_NAMECOLUMNS_H
#define HOST_WRITE_HX_NAMECOLUMNS_H

#include <cstddef>
#include <string>
#include <vector>

#include "host/names/HX_FormedName.h"

/// The names of all columns.
std::vector<std::string> HX_NameColumns();

/// The cells of \p name, "-" for an empty cell.
/// REQUIRES: \p columns are names of columns.
std::vector<std::string> HX_RowOf(const HX_FormedName& name,
                                  const std::vector<std::string>& columns);

/// The last \p width characters of \p text, with "..." for the rest.
std::string HX_TailOf(const std::string& text, std::size_t width);

/// RETURNS: empty for a filter "COLUMN=PATTERN", "COLUMN!=PATTERN" or a text,
/// else what is wrong: an unknown column.
std::string HX_CheckFilter(const std::string& filter);

/// Leaves out the names that do not pass all \p filters, and sorts by the
/// column \p sort, equal cells in the old order; "" keeps the order. Numbers
/// in cells compare by value.
/// REQUIRES: filters pass HX_CheckFilter().
void HX_SelectNames(std::vector<const HX_FormedName*>& names,
                    const std::vector<std::string>& filters,
                    const std::string& sort);

#endif  // HOST_WRITE_HX_NAMECOLUMNS_H
