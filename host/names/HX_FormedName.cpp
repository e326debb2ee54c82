#include "host/names/HX_FormedName.h"

#include <algorithm>
#include <iterator>

#include "SourceRef/HxCSrcRefServer.h"

namespace {

// In the order of HX_Change::HxEReasonTag.
constexpr const char* kReasons[] = {"",
                                    "made an identifier",
                                    "shortened",
                                    "keyword",
                                    "base type name",
                                    "type name",
                                    "taken by a constant",
                                    "taken by",
                                    "reserved by the pattern",
                                    "rewritten",
                                    "not distinct from",
                                    "held by the lock for",
                                    "retired by the lock with",
                                    "name of the lock",
                                    "without a free variant",
                                    "name of the C library",
                                    "macro of the generated code"};

// In the order of HX_Change::HxEReasonTag; the schema of name maps lists them.
constexpr const char* kKinds[] = {
    "none",     "madeIdentifier", "shortened",       "keyword",
    "baseType", "typeName",       "takenByConstant", "takenByName",
    "pattern",  "rewritten",      "indistinct",      "held",
    "retired",  "locked",         "noVariant",       "library",
    "macro"};
static_assert(std::size(kKinds) == std::size(kReasons));

bool hasError(const std::vector<HX_Finding>& findings) {
  return std::any_of(findings.begin(), findings.end(),
                     [](const HX_Finding& each) { return each.isError(); });
}

}  // namespace

std::string HX_Change::text() const {
  std::string text = kReasons[reason];
  if (!detail.empty()) text += " '" + detail + "'";
  if (owner == nullptr) return text;
  const std::string path = HX_PathOf(HX_BestSource(*owner));
  const std::string id = "'" + owner->id + "'";
  const char* const of = detail.empty() ? " " : " of ";
  return text + of + (path.empty() ? id : path + " (" + id + ")");
}

const char* HX_Change::kind() const { return kKinds[reason]; }

std::string HX_FormedName::sourcePath() const {
  return HX_PathOf(HX_BestSource(*wanted));
}

const HxCSrcRef* HX_BestSource(const HX_WantedName& name) {
  if (name.dd == nullptr && name.rare().alsoFrom.empty()) return name.source;
  const HxCSrcRef* block = nullptr;
  const HxCSrcRef* dd = nullptr;
  const HxCSrcRef* other = nullptr;
  const HxCSrcRefSet sources = name.sources();
  HxCSrcRefServer::getSpecificSrcRefFromSet(&sources, &block, &dd, &other);
  if (block != nullptr) return block;
  return dd != nullptr ? dd : other;
}

std::string HX_JoinedChanges(const HX_FormedName& name, const char* separator) {
  std::string all;
  for (const HX_Change& change : name.changes)
    all += (all.empty() ? "" : separator) + change.text();
  return all;
}

bool HX_RunResult::hasErrors() const {
  return hasError(findings) || std::any_of(formed.begin(), formed.end(),
                                           [](const HX_FormedName& name) {
                                             return hasError(name.findings);
                                           });
}
