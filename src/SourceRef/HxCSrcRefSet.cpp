#include "SourceRef/HxCSrcRefSet.h"

#include <algorithm>

namespace {

using SrcRefIterator = HX_Iterator<const HxCSrcRef*>;

constexpr int kBehindTheEnd = -1;  // thrown by currentItem()

class EmptyIterator : public SrcRefIterator {
 public:
  void first() override {}
  void next() override {}
  bool isDone() const override { return true; }
  const HxCSrcRef* currentItem() const override { throw kBehindTheEnd; }
};

class SingleIterator : public SrcRefIterator {
 public:
  explicit SingleIterator(const HxCSrcRef* const& slot) : m_Slot(slot) {}

  void first() override { m_IsDone = false; }
  void next() override { m_IsDone = true; }
  bool isDone() const override { return m_IsDone; }
  const HxCSrcRef* currentItem() const override {
    if (m_IsDone) throw kBehindTheEnd;
    return m_Slot;
  }

 private:
  const HxCSrcRef* const& m_Slot;  // in the set
  bool m_IsDone = false;
};

class ListIterator : public SrcRefIterator {
 public:
  explicit ListIterator(const leda::list<const HxCSrcRef*>& list)
      : m_List(list), m_Item(list.first()) {}

  void first() override { m_Item = m_List.first(); }
  void next() override {
    if (m_Item) m_Item = m_List.succ(m_Item);
  }
  bool isDone() const override { return !m_Item; }
  const HxCSrcRef* currentItem() const override {
    if (!m_Item) throw kBehindTheEnd;
    return m_List[m_Item];
  }

 private:
  const leda::list<const HxCSrcRef*>& m_List;  // of the set
  leda::list_item<const HxCSrcRef*> m_Item;
};

}  // namespace

HxCSrcRefSet& HxCSrcRefSet::operator=(const HxCSrcRefSet& other) {
  if (this == &other) return *this;
  clear();
  if (other.getSrcRefCnt() < 2) {
    m_Content.one = other.getASrcRef();
    return *this;
  }
  m_Content.list = new List(*other.m_Content.list);
  m_IsSingle = false;
  return *this;
}

void HxCSrcRefSet::addSrcRef(const HxCSrcRefSet& other) {
  if (this == &other) return;
  other.forEach([this](const HxCSrcRef* srcRef) { addSrcRef(srcRef); });
}

void HxCSrcRefSet::addToNonEmpty(const HxCSrcRef* srcRef) {
  if (srcRef != nullptr && !contains(srcRef)) appendNew(srcRef);
}

void HxCSrcRefSet::appendNew(const HxCSrcRef* srcRef) {
  if (m_IsSingle && m_Content.one == nullptr) {
    m_Content.one = srcRef;
    return;
  }
  if (m_IsSingle) changeToList();
  m_Content.list->append(srcRef);
}

bool HxCSrcRefSet::contains(const HxCSrcRef* srcRef) const {
  if (m_IsSingle) return m_Content.one == srcRef;
  const auto end = m_Content.list->end();
  return std::find(m_Content.list->begin(), end, srcRef) != end;
}

void HxCSrcRefSet::changeToList() {
  auto* list = new List;
  list->append(m_Content.one);
  m_Content.list = list;
  m_IsSingle = false;
}

int HxCSrcRefSet::getSrcRefCnt() const {
  if (!m_IsSingle) return m_Content.list->size();
  return m_Content.one != nullptr ? 1 : 0;
}

const HxCSrcRef* HxCSrcRefSet::getASrcRef() const {
  return m_IsSingle ? m_Content.one : m_Content.list->front();
}

SrcRefIterator* HxCSrcRefSet::createIterator() const {
  if (!m_IsSingle) return new ListIterator(*m_Content.list);
  if (m_Content.one != nullptr) return new SingleIterator(m_Content.one);
  return new EmptyIterator;
}
