#include "SafeNames/HX_NameLock.h"

#include <algorithm>
#include <charconv>
#include <iterator>
#include <new>
#include <string>

#include "Control/HX_Memory.h"
#include "SafeNames/implSafeNames/HX_TextLines.h"
#include "implContainers/HX_HashTable.h"
#include "implContainers/HX_PlainArray.h"
#include "implContainers/HX_TextArena.h"
#include "implContainers/HX_Vector.h"

namespace {

using View = std::string_view;
using hx_detail::keyOf;
using hx_detail::quoted;

constexpr View kHeader = "hx_names_lock 1";
constexpr View kMarkers[] = {"<<<<<<<", "|||||||", "=======", ">>>>>>>"};
constexpr View kEscapedFirst = "<|=>#";

enum Field { eItem, eName, eWanted, eScope, eLinkage, eRuns, eFixedFields };
constexpr std::size_t kFormerFields = 3;

struct EscapeRow {
  char character;
  char code;
};
constexpr EscapeRow kEscapes[] = {
    {'\t', 't'}, {'\n', 'n'}, {'\r', 'r'}, {'\\', '\\'}};

bool isMarker(View line) {
  return std::any_of(
      std::begin(kMarkers), std::end(kMarkers),
      [&](View marker) { return line.substr(0, marker.size()) == marker; });
}

// False for a backslash without a known escape.
bool unescape(View field, std::string& text) {
  text.clear();
  for (std::size_t i = 0; i < field.size(); ++i) {
    if (field[i] != '\\') {
      text += field[i];
      continue;
    }
    if (++i == field.size()) return false;
    const auto* const row =
        std::find_if(std::begin(kEscapes), std::end(kEscapes),
                     [&](const EscapeRow& r) { return r.code == field[i]; });
    if (row != std::end(kEscapes))
      text += row->character;
    else if (i == 1 && kEscapedFirst.find(field[i]) != View::npos)
      text += field[i];
    else
      return false;
  }
  return true;
}

void appendField(std::string& line, View text) {
  for (const char c : text) {
    const auto* const row =
        std::find_if(std::begin(kEscapes), std::end(kEscapes),
                     [c](const EscapeRow& r) { return r.character == c; });
    if (row != std::end(kEscapes)) line += '\\';
    line += row != std::end(kEscapes) ? row->code : c;
  }
}

// A whole number without a sign.
bool readNumber(View text, int& number) {
  if (text.empty() || !hx_detail::isDigit(text.front())) return false;
  const char* const end = text.data() + text.size();
  const auto read = std::from_chars(text.data(), end, number);
  return read.ec == std::errc() && read.ptr == end;
}

bool readLinkage(View text, bool& isExternal) {
  isExternal = text == "e";
  return isExternal || text == "i";
}

}  // namespace

struct HX_NameLock::Items : HX_Allocated {
  struct Item {
    Entry entry;
    int firstFormer;  // -1: none
    HxEChangeTag change;
  };
  struct Former {
    std::string_view name;
    std::string_view scope;
    bool isExternal;
    int runs;
    int next;  // of the same item; -1: none
  };

  Item& item(int position) { return items[static_cast<unsigned>(position)]; }
  Former& former(int at) { return formers[static_cast<unsigned>(at)]; }
  int count() const { return static_cast<int>(items.size()); }

  int find(View wanted) const {
    const auto* const slot = index.find(keyOf(wanted), [&](unsigned at) {
      return items[at].entry.item == wanted;
    });
    return slot == nullptr ? -1 : static_cast<int>(slot->value);
  }

  // Copy for the life of the lock. Throws std::bad_alloc.
  View keep(View text) {
    if (text.empty()) return {};
    const char* const kept = texts.add(text.data(), text.size());
    if (kept == nullptr) throw std::bad_alloc();
    return {kept, text.size()};
  }

  // Takes the texts of \p entry without a copy. Throws std::bad_alloc.
  void add(const Entry& entry, HxEChangeTag change) {
    if (!items.append(Item{entry, -1, change})) throw std::bad_alloc();
    if (index.add(keyOf(entry.item), items.size() - 1) != nullptr) return;
    items.dropLast();
    throw std::bad_alloc();
  }

  // In front of older former names. Throws std::bad_alloc.
  void addFormer(Item& item, const Former& added) {
    if (!formers.append(added)) throw std::bad_alloc();
    const int position = static_cast<int>(formers.size()) - 1;
    former(position).next = item.firstFormer;
    item.firstFormer = position;
  }

  template <class IsDropped>
  void dropFormers(Item& item, IsDropped isDropped) {
    int* link = &item.firstFormer;
    while (*link >= 0) {
      Former& tried = former(*link);
      if (isDropped(tried))
        *link = tried.next;
      else
        link = &tried.next;
    }
  }

  void drop(Item& item) {
    const int position = find(item.entry.item);
    index.erase(index.find(keyOf(item.entry.item), [position](unsigned at) {
      return static_cast<int>(at) == position;
    }));
    item = Item{Entry{}, -1, eGone};
  }

  HX_PlainArray<Item> items;  // as read, then as noted
  HX_PlainArray<Former> formers;
  HX_HashTable<int, unsigned> index;  // positions, by the hash of the item
  HX_TextArena texts;
};

HX_NameLock::HX_NameLock() : m_pItems(new Items) {}

HX_NameLock::~HX_NameLock() { delete m_pItems; }

// Reads line by line. A wrong line is a fault; reading goes on.
struct HX_NameLock::Reader {
  struct NamePlace {
    View name;
    View scope;
    int line;
  };

  void readLine(View line, int number) {
    lastLine = number;
    if (number == 1) {
      if (line != kHeader)
        fault(number,
              "expected '" + std::string(kHeader) + "', found " + quoted(line));
      return;
    }
    if (isMarker(line))
      return fault(number, "conflict marker of a merge: " + quoted(line));
    split(line);
    Entry entry;
    if (fields.size() < eFixedFields ||
        (fields.size() - eFixedFields) % kFormerFields != 0)
      return fault(number,
                   "expected 6 fields and 3 for each former name, "
                   "found " +
                       std::to_string(fields.size()) + " fields");
    if (!readEntry(entry))
      return fault(number, "wrong " + std::string(wrongField) + ": " +
                               quoted(fields[wrongAt]));
    checkPlace(entry, number);
    items.add(entry, eGone);
    itemLines.push_back(number);
    Items::Item& item = items.item(items.count() - 1);
    noteName(item.entry.name, item.entry.scope, number);
    for (std::size_t at = fields.size(); at > eFixedFields;) {
      at -= kFormerFields;
      Items::Former former{};
      if (!readFormer(at, former))
        return fault(number, "wrong former name: " + quoted(fields[at]));
      items.addFormer(item, former);
      noteName(former.name, former.scope, number);
    }
  }

  void split(View line) {
    fields.clear();
    for (std::size_t from = 0;;) {
      const std::size_t tab = line.find('\t', from);
      fields.push_back(line.substr(from, tab - from));
      if (tab == View::npos) return;
      from = tab + 1;
    }
  }

  bool wrong(std::size_t at, const char* what) {
    wrongAt = at;
    wrongField = what;
    return false;
  }

  // The views stay as long as the lock.
  bool readText(std::size_t at, const char* what, View& text) {
    if (!unescape(fields[at], buffer)) return wrong(at, what);
    text = items.keep(buffer);
    return true;
  }

  bool readEntry(Entry& entry) {
    if (!readText(eItem, "item", entry.item)) return false;
    if (entry.item.empty()) return wrong(eItem, "item");
    if (!hx_detail::isIdentifier(fields[eName])) return wrong(eName, "name");
    if (!hx_detail::isIdentifier(fields[eWanted]))
      return wrong(eWanted, "wanted name");
    entry.name = items.keep(fields[eName]);
    entry.wanted = fields[eWanted] == fields[eName]
                       ? entry.name
                       : items.keep(fields[eWanted]);
    if (!readText(eScope, "scope", entry.scope)) return false;
    if (!readLinkage(fields[eLinkage], entry.isExternal))
      return wrong(eLinkage, "linkage");
    return fields[eRuns] == "-" ||
           readNumber(fields[eRuns], entry.retiredRuns) ||
           wrong(eRuns, "number of runs");
  }

  bool readFormer(std::size_t at, Items::Former& former) {
    if (!hx_detail::isIdentifier(fields[at])) return false;
    former.name = items.keep(fields[at]);
    if (!readText(at + 1, "scope", former.scope)) return false;
    const View end = fields[at + 2];
    return !end.empty() && readLinkage(end.substr(0, 1), former.isExternal) &&
           readNumber(end.substr(1), former.runs);
  }

  // Faults: a second line of an item, a line out of order.
  void checkPlace(const Entry& entry, int number) {
    const int earlier = items.find(entry.item);
    if (earlier >= 0)
      fault(number,
            "the item " + quoted(entry.item) + " stands in line " +
                std::to_string(itemLines[static_cast<std::size_t>(earlier)]) +
                " already");
    else if (items.count() > 0 &&
             entry.item < items.item(items.count() - 1).entry.item)
      fault(number, "out of order: " + quoted(entry.item));
  }

  void noteName(View name, View scope, int number) {
    const auto bits = static_cast<unsigned>(keyOf(scope)) * 31;
    const int key = static_cast<int>(bits) ^ keyOf(name);
    const auto* const slot = names.find(key, [&](const NamePlace& place) {
      return place.name == name && place.scope == scope;
    });
    if (slot != nullptr)
      return fault(number, "the name '" + std::string(name) + "' of scope " +
                               quoted(scope) + " stands in line " +
                               std::to_string(slot->value.line) + " already");
    if (names.add(key, NamePlace{name, scope, number}) == nullptr)
      throw std::bad_alloc();
  }

  void fault(int number, const std::string& text) {
    faults.add(number, text.c_str());
    isGood = false;
  }

  Items& items;
  HX_TextFaults& faults;
  bool isGood = true;
  int lastLine = 0;
  HX_Vector<View> fields{};
  HX_Vector<int> itemLines{};  // by position
  std::string buffer{};
  HX_HashTable<int, NamePlace> names{};
  std::size_t wrongAt = 0;
  const char* wrongField = "";
};

bool HX_NameLock::read(const char* text, std::size_t length,
                       HX_TextFaults& faults) {
  if (size() != 0) {
    faults.add(0, "the lock is not empty");
    return false;
  }
  const bool isRead = HX_WithinMemory(false, [&] {
    if (m_pItems == nullptr) return false;
    Reader reader{*m_pItems, faults};
    const View whole(text, length);
    hx_detail::forEachLine(
        whole, [&](View line, int number) { reader.readLine(line, number); });
    if (reader.lastLine == 0) reader.readLine({}, 1);
    if (whole.empty() || whole.back() != '\n')
      reader.fault(reader.lastLine, "the last line has no end");
    return reader.isGood;
  });
  if (isRead) return true;
  if (faults.count() == 0) faults.add(0, "no memory for the lock");
  if (m_pItems == nullptr) return false;
  m_pItems->index.clear();
  while (m_pItems->items.size() != 0) m_pItems->items.dropLast();
  while (m_pItems->formers.size() != 0) m_pItems->formers.dropLast();
  return false;
}

int HX_NameLock::size() const {
  return m_pItems == nullptr ? 0 : m_pItems->count();
}

const HX_NameLock::Entry& HX_NameLock::entry(int position) const {
  return m_pItems->item(position).entry;
}

HX_NameLock::HxEChangeTag HX_NameLock::change(int position) const {
  return m_pItems->item(position).change;
}

int HX_NameLock::find(std::string_view item) const {
  return m_pItems == nullptr ? -1 : m_pItems->find(item);
}

void HX_NameLock::visitHeldNames(HeldVisit visit, void* to) const {
  for (int at = 0; at < size(); ++at) {
    const Items::Item& item = m_pItems->item(at);
    const Entry& entry = item.entry;
    if (entry.item.empty()) continue;
    visit(to, entry.name, entry.scope, entry.isExternal, at);
    for (int i = item.firstFormer; i >= 0; i = m_pItems->former(i).next) {
      const Items::Former& former = m_pItems->former(i);
      visit(to, former.name, former.scope, former.isExternal, at);
    }
  }
}

void HX_NameLock::beginRun() {
  for (int at = 0; at < size(); ++at) m_pItems->item(at).change = eGone;
}

bool HX_NameLock::note(const Entry& entry) {
  if (entry.item.empty() || m_pItems == nullptr) return false;
  return HX_WithinMemory([&] {
    const int position = find(entry.item);
    const Entry old = position < 0 ? Entry{} : this->entry(position);
    // Equal texts share a copy.
    const auto kept = [this](View text, View before) {
      return text == before ? before : m_pItems->keep(text);
    };
    // Neighbours mostly share their scope.
    const View neighbour = size() == 0 ? View() : this->entry(size() - 1).scope;
    Entry noted;
    noted.item = kept(entry.item, old.item);
    noted.name = kept(entry.name, old.name);
    noted.wanted = entry.wanted == entry.name ? noted.name
                                              : kept(entry.wanted, old.wanted);
    noted.scope =
        entry.scope == old.scope ? old.scope : kept(entry.scope, neighbour);
    noted.isExternal = entry.isExternal;
    if (position < 0) return m_pItems->add(noted, eAdded);

    Items::Item& item = m_pItems->item(position);
    const bool isSame = noted.name == old.name && noted.scope == old.scope;
    if (!isSame)
      m_pItems->addFormer(
          item, Items::Former{old.name, old.scope, old.isExternal, 0, -1});
    m_pItems->dropFormers(item, [&](const Items::Former& f) {
      return f.name == noted.name && f.scope == noted.scope;
    });
    if (!isSame)
      item.change = eRenamed;
    else if (item.change == eGone)
      item.change = old.retiredRuns >= 0 ? eRevived : eKept;
    item.entry = noted;
  });
}

void HX_NameLock::noteKept(int position) {
  Items::Item& item = m_pItems->item(position);
  if (item.change == eGone)
    item.change = item.entry.retiredRuns >= 0 ? eRevived : eKept;
  item.entry.retiredRuns = -1;
}

void HX_NameLock::endRun(int retireRuns) {
  const auto isOver = [retireRuns](int& runs) {
    return retireRuns > 0 && ++runs >= retireRuns;
  };
  for (int at = 0; at < size(); ++at) {
    Items::Item& item = m_pItems->item(at);
    if (item.entry.item.empty()) continue;
    // A name replaced in this run starts to count with the next run.
    const Items::Former* const replaced =
        item.change == eRenamed ? &m_pItems->former(item.firstFormer) : nullptr;
    m_pItems->dropFormers(item, [&](Items::Former& former) {
      return &former != replaced && isOver(former.runs);
    });
    if (item.change != eGone) continue;
    int& runs = item.entry.retiredRuns;
    if (runs < 0)
      runs = 0;
    else if (isOver(runs))
      m_pItems->drop(item);
  }
}

void HX_NameLock::prune() {
  for (int at = 0; at < size(); ++at) {
    Items::Item& item = m_pItems->item(at);
    m_pItems->dropFormers(item, [](const Items::Former&) { return true; });
    if (item.entry.retiredRuns >= 0) m_pItems->drop(item);
  }
}

bool HX_NameLock::writeTo(Sink sink, void* to) const {
  return HX_WithinMemory([&] {
    constexpr std::size_t kPiece = 1 << 16;
    HX_Vector<const Items::Item*> items;
    items.reserve(static_cast<std::size_t>(size()));
    for (int at = 0; at < size(); ++at)
      if (!entry(at).item.empty()) items.push_back(&m_pItems->item(at));
    std::sort(items.begin(), items.end(),
              [](const Items::Item* a, const Items::Item* b) {
                return a->entry.item < b->entry.item;
              });
    std::string text(kHeader);
    text += '\n';
    for (const Items::Item* item : items) {
      const Entry& entry = item->entry;
      if (kEscapedFirst.find(entry.item.front()) != View::npos) text += '\\';
      appendField(text, entry.item);
      for (const View field : {entry.name, entry.wanted, entry.scope}) {
        text += '\t';
        appendField(text, field);
      }
      text += entry.isExternal ? "\te\t" : "\ti\t";
      text += entry.retiredRuns < 0 ? "-" : std::to_string(entry.retiredRuns);
      for (int i = item->firstFormer; i >= 0; i = m_pItems->former(i).next) {
        const Items::Former& former = m_pItems->former(i);
        text += '\t';
        appendField(text, former.name);
        text += '\t';
        appendField(text, former.scope);
        text += former.isExternal ? "\te" : "\ti";
        text += std::to_string(former.runs);
      }
      text += '\n';
      if (text.size() < kPiece) continue;
      sink(to, text.data(), text.size());
      text.clear();
    }
    sink(to, text.data(), text.size());
  });
}
