// The ids of one kind of items: definitions and uses in any order.
//
//   HX_IdTable ids("a type");
//   const int use = ids.entry("speed");     // not yet defined
//   ids.define(ids.entry("speed"), 7);
//   ids.item(use);                          // 7

#ifndef HOST_MODEL_HX_IDTABLE_H
#define HOST_MODEL_HX_IDTABLE_H

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

/// Hash table with open addressing over one common text: 16 to 24 bytes and the
/// characters for each id.
class HX_IdTable {
 public:
  /// \param what  for complaints: "a type"
  explicit HX_IdTable(const char* what) : m_What(what), m_Slots(64, kNone) {}

  /// The number of the id; a new id gets the next number.
  int entry(std::string_view id);

  std::string_view text(int number) const {
    const Entry& found = m_Entries[static_cast<std::size_t>(number)];
    return std::string_view(m_Text).substr(found.begin, found.length);
  }
  /// Index of the item in a list of the user; -1 for an id without an item.
  int item(int number) const {
    return m_Entries[static_cast<std::size_t>(number)].item;
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
  struct Entry {
    std::uint32_t begin;  // in m_Text
    std::uint32_t length;
    std::uint32_t hash;
    int item;
  };
  static constexpr int kNone = -1;

  void grow();

  const char* m_What;
  std::string m_Text;
  std::vector<Entry> m_Entries;
  std::vector<int> m_Slots;  // numbers; at most half of the slots are taken
};

#endif  // HOST_MODEL_HX_IDTABLE_H
