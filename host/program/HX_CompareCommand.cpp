// hx_codegen diff: two sets of names, each a document, a lock or a name map.
#include <iostream>
#include <nlohmann/json.hpp>

#include "host/program/HX_Commands.h"
#include "host/program/HX_NameSets.h"

namespace {

using nlohmann::ordered_json;

constexpr const char* kChanges[] = {"kept", "added", "removed", "renamed"};

void writeTable(const HX_NameDiff& diff) {
  for (int i = 0; i < diff.rowCount(); ++i) {
    const HX_NameDiff::Row& row = diff.row(i);
    if (row.change == HX_NameDiff::eKept) continue;
    const bool isGone = row.change == HX_NameDiff::eRemoved;
    const std::string reason = HX_ReasonOf(row);
    std::cout << kChanges[row.change] << "  "
              << (isGone ? row.before.item : row.after.item) << "  "
              << row.before.name
              << (row.change == HX_NameDiff::eRenamed ? " -> " : "")
              << row.after.name << (reason.empty() ? "" : "  (" + reason + ")")
              << '\n';
  }
  const char* separator = "";
  for (const auto change : {HX_NameDiff::eKept, HX_NameDiff::eAdded,
                            HX_NameDiff::eRemoved, HX_NameDiff::eRenamed}) {
    std::cout << separator << diff.count(change) << ' ' << kChanges[change];
    separator = ", ";
  }
  std::cout << '\n';
}

void writeJson(const HX_NameDiff& diff) {
  ordered_json rows = ordered_json::array();
  for (int i = 0; i < diff.rowCount(); ++i) {
    const HX_NameDiff::Row& row = diff.row(i);
    ordered_json entry{
        {"change", kChanges[row.change]},
        {"id", row.before.item.empty() ? row.after.item : row.before.item}};
    if (row.change != HX_NameDiff::eAdded) entry["old"] = row.before.name;
    if (row.change != HX_NameDiff::eRemoved) entry["new"] = row.after.name;
    const std::string reason = HX_ReasonOf(row);
    if (!reason.empty()) entry["reason"] = reason;
    rows.push_back(entry);
  }
  std::cout << ordered_json{{"names", rows}}.dump(2) << '\n';
}

// A script for sed. Names are C identifiers, so nothing needs an escape.
void writeSubstitutions(const HX_NameDiff& diff) {
  for (int i = 0; i < diff.ambiguousCount(); ++i)
    std::cout << "# " << diff.ambiguous(i)
              << ": several new names, depending on the scope\n";
  for (int i = 0; i < diff.substitutionCount(); ++i)
    std::cout << "s/\\b" << diff.substitution(i).from << "\\b/"
              << diff.substitution(i).to << "/g\n";
}

}  // namespace

HX_ExitCode HX_CompareNames(const HX_Arguments& arguments) {
  HX_NameDiff diff;
  HX_AddNames(diff, HX_NameDiff::eOld, arguments.older, arguments);
  HX_AddNames(diff, HX_NameDiff::eNew, arguments.model, arguments);
  if (!diff.compare()) throw std::bad_alloc();
  if (arguments.format == "json")
    writeJson(diff);
  else if (arguments.format == "sed")
    writeSubstitutions(diff);
  else
    writeTable(diff);
  return kHxDone;
}
