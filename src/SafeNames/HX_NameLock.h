// Lock file: keeps the name of every item from run to run.
//
//   HX_NameLock lock;
//   HX_TextFaults faults;
//   if (!lock.read(text, length, faults)) ...       // damaged or merged badly
//   HX_SafeNames names(lock);                       // notes every name given
//   lock.endRun(0);                                 // retires absent items
//   lock.write([&](const char* text, std::size_t length) { ... });
//
// A lock file is UTF-8 text with a line per item, ascending by the bytes of the
// item:
//
//   hx_names_lock 1
//   gain <TAB> gain_b <TAB> gain <TAB> file <TAB> i <TAB> -
//
// Fields: item, name, wanted name, scope, linkage
// (e external, i internal) and "-" for an item of the last run or, for a
// retired item, the number of runs since the item went. Three more fields per
// former name of the item: name, scope and linkage with the number of runs
// ("i2"). Tab, line feed, carriage return and backslash are written "\t", "\n",
// "\r" and "\\", and a backslash stands before a first '<', '=', '>', '|', '#'.

#ifndef SAFENAMES_HX_NAMELOCK_H
#define SAFENAMES_HX_NAMELOCK_H

#include <cstddef>
#include <string_view>
#include <type_traits>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "SafeNames/HX_TextFaults.h"

/// Not copied. Texts are bytes in UTF-8, compared by bytes. Reports no message.
class HX_UTILS_API HX_NameLock : public HX_Allocated {
 public:
  /// Name of an item.
  struct Entry {
    std::string_view item;    ///< the host's id of the item, never empty
    std::string_view name;    ///< the name that the item has
    std::string_view wanted;  ///< the name before the search for a free one
    std::string_view scope;   ///< the host's name of the scope
    bool isExternal = false;  ///< whether the name has external linkage
    /// Runs since the item went; negative for an item of the last run.
    int retiredRuns = -1;
  };

  /// What a run has done to an item.
  enum HxEChangeTag : int {
    eGone = 0,     ///< the run had no such item
    eKept = 1,     ///< the same name
    eAdded = 2,    ///< an item without a name before
    eRenamed = 3,  ///< another name
    /// A retired item with the old name again.
    eRevived = 4
  };

  /// No item; a run adds all items.
  HX_NameLock();
  HX_NameLock(const HX_NameLock&) = delete;
  HX_NameLock& operator=(const HX_NameLock&) = delete;
  ~HX_NameLock();

  /// Reads a lock file of \p length bytes into an empty lock.
  /// RETURNS: false, with the lock as before, for a lock that is not empty,
  /// another version, conflict markers, an item or a name of a scope on two
  /// lines, lines out of order, a wrong field, an unfinished last line, or no
  /// memory; \p faults has the lines.
  bool read(const char* text, std::size_t length, HX_TextFaults& faults);

  /// Writes the lock file in pieces: \p sink(const char* text, size_t length).
  /// RETURNS: false, perhaps after some pieces, without memory.
  template <class Output>
  bool write(Output&& sink) const {
    return writeTo(
        [](void* to, const char* text, std::size_t length) {
          (*static_cast<std::remove_reference_t<Output>*>(to))(text, length);
        },
        &sink);
  }

  /// The number of entries, dropped ones included. Positions count from 0.
  int size() const;
  /// The entry at \p position; a dropped entry has an empty item.
  /// REQUIRES: \p position in [0, size()).
  const Entry& entry(int position) const;
  /// What the current or last run has done to the entry at \p position.
  /// REQUIRES: \p position in [0, size()).
  HxEChangeTag change(int position) const;
  /// The position of \p item; -1 for an unknown item.
  int find(std::string_view item) const;

  /// Calls \p visit(name, scope, isExternal, position) for every name that is
  /// held for an item: present names and former names.
  template <class Visit>
  void forEachHeldName(Visit&& visit) const {
    visitHeldNames(
        [](void* to, std::string_view name, std::string_view scope,
           bool isExternal, int position) {
          (*static_cast<std::remove_reference_t<Visit>*>(to))(
              name, scope, isExternal, position);
        },
        &visit);
  }

  /// Begins a run: every item counts as gone until note().
  void beginRun();

  /// Notes the name of an item in this run. A different older name of the item
  /// becomes a former name.
  /// RETURNS: false, with nothing changed, for an empty item or without memory.
  bool note(const Entry& entry);

  /// The same for an item that keeps name, wanted name, scope and linkage.
  /// REQUIRES: the entry at \p position was not dropped.
  void noteKept(int position);

  /// Ends a run: items without note() are retired.
  /// \param retireRuns  number of runs after which retired items and former
  ///                    names are dropped; 0 keeps them until prune(), and does
  ///                    not count runs
  void endRun(int retireRuns);

  /// Drops retired items and former names.
  void prune();

 private:
  struct Items;
  struct Reader;
  using Sink = void (*)(void* to, const char* text, std::size_t length);
  using HeldVisit = void (*)(void* to, std::string_view name,
                             std::string_view scope, bool isExternal,
                             int position);

  bool writeTo(Sink sink, void* to) const;
  void visitHeldNames(HeldVisit visit, void* to) const;

  Items* m_pItems;  // owned; null without memory
};

#endif  // SAFENAMES_HX_NAMELOCK_H
