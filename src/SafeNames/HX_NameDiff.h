// Difference of two sets of names: kept, added, removed and renamed items, with
// reasons, and a list of substitutions for hand-written code.
//
//   HX_NameDiff diff;
//   diff.add(HX_NameDiff::eOld, {"gain", "gain_b", "gain"});
//   diff.add(HX_NameDiff::eNew, {"gain", "gain", "gain"});
//   diff.compare();
//   diff.row(0).change;         // eRenamed
//   diff.substitution(0).from;  // "gain_b"

#ifndef SAFENAMES_HX_NAMEDIFF_H
#define SAFENAMES_HX_NAMEDIFF_H

#include <string_view>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

/// Not copied. Texts are UTF-8, copied by add(), compared by bytes.
class HX_UTILS_API HX_NameDiff : public HX_Allocated {
 public:
  /// Facts about a name. Only item and name are needed; empty facts give no
  /// reason.
  struct Record {
    std::string_view item = {};    ///< id, the same in both sets
    std::string_view name = {};    ///< given name
    std::string_view wanted = {};  ///< name before the search for a free name
    std::string_view nameTemplate = {};  ///< template of the name
    std::string_view place = {};         ///< path in the model
    std::string_view changes = {};       ///< why name and wanted name differ
  };

  /// The set before and the set now.
  enum HxESideTag : int { eOld = 0, eNew = 1 };
  /// Fate of an item.
  enum HxEChangeTag : int { eKept = 0, eAdded = 1, eRemoved = 2, eRenamed = 3 };
  /// Why an item is renamed. The first that applies counts.
  enum HxEReasonTag : int {
    eNoReason = 0,  ///< the facts do not tell, or the item is not renamed
    eTemplate = 1,  ///< another template
    ePlace = 2,     ///< another path: a block was renamed or moved
    eWanted = 3,    ///< another wanted name, for example another macro value
    eChanges = 4,   ///< a new conflict, or cut: see the new record's changes
    eUnchanged = 5  ///< the old conflict is gone: see the old record's changes
  };

  /// An item in one set or both. The absent record has an empty item.
  struct Row {
    /// Fate of the item, reason of a renaming, the two records.
    HxEChangeTag change = eKept;
    HxEReasonTag reason = eNoReason;
    Record before;
    Record after;
  };

  /// "Replace the whole word from by to." Applied one after the other, the
  /// substitutions never replace a word twice.
  struct Substitution {
    /// Old word and new word.
    std::string_view from;
    std::string_view to;
  };

  HX_NameDiff();
  HX_NameDiff(const HX_NameDiff&) = delete;
  HX_NameDiff& operator=(const HX_NameDiff&) = delete;
  ~HX_NameDiff();

  /// RETURNS: false, with nothing changed, without memory.
  bool add(HxESideTag side, const Record& record);

  /// Compares the two sets. Of records with the same item of one side the last
  /// counts. COST: n log n for n records.
  /// RETURNS: false, without rows, without memory.
  bool compare();

  /// Rows by ascending item.
  int rowCount() const;
  const Row& row(int index) const;
  /// The number of rows of a kind.
  int count(HxEChangeTag change) const;

  /// Substitutions for the renamed items. A cycle of names goes through a word
  /// "hx_swap_1", "hx_swap_2", ... that no record has as name.
  int substitutionCount() const;
  const Substitution& substitution(int index) const;
  /// Old names without a substitution: items of different scopes share the
  /// name, and the new names differ.
  int ambiguousCount() const;
  std::string_view ambiguous(int index) const;

 private:
  struct Content;

  Content* m_pContent;  // owned; null without memory
};

#endif  // SAFENAMES_HX_NAMEDIFF_H
