// The ids of one kind of items: definitions and uses in any order.
//
//   HX_IdTable ids("a type");
//   const int use = ids.entry("speed");     // not yet defined
//   ids.define(ids.entry("speed"), 7, place);
//   ids[use].item;                          // 7

#ifndef HOST_MODEL_HX_IDTABLE_H
#define HOST_MODEL_HX_IDTABLE_H

#include <cstdint>
#include <deque>
#include <functional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "host/base/HX_Faults.h"

class HX_IdTable {
 public:
  struct Entry {
    const std::string* text;
    int item = -1;  // index of the item in a list of the user; -1: not defined
  };

  /// \param what  for complaints: "a type"
  explicit HX_IdTable(const char* what) : m_What(what) {}

  /// The number of the id; a new id gets the next number.
  int entry(std::string_view id) {
    const auto [found, isNew] = m_Numbers.try_emplace(
        std::string(id), static_cast<int>(m_Entries.size()));
    if (isNew) m_Entries.push_back({&found->first});
    return found->second;
  }

  const Entry& operator[](int number) const {
    return m_Entries[static_cast<std::size_t>(number)];
  }

  /// \return false if another item has the id
  bool define(int number, int item) {
    Entry& defined = m_Entries[static_cast<std::size_t>(number)];
    if (defined.item >= 0) return false;
    defined.item = item;
    return true;
  }

  const char* what() const { return m_What; }

 private:
  const char* m_What;
  std::unordered_map<std::string, int> m_Numbers;
  std::vector<Entry> m_Entries;
};

#endif  // HOST_MODEL_HX_IDTABLE_H
