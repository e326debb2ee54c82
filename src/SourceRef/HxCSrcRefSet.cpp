#include "SourceRef/HxCSrcRefSet.h"

#include <algorithm>
#include <cstddef>

namespace {

using SrcRefIterator = HX_Iterator<const HxCSrcRef*>;

constexpr int kBehindTheEnd = -1;          // thrown by currentItem()
constexpr std::size_t kFirstCapacity = 4;  // few items have more sources

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
  explicit ListIterator(const std::vector<const HxCSrcRef*>& list)
      : m_List(list) {}

  void first() override { m_Index = 0; }
  void next() override {
    if (!isDone()) ++m_Index;
  }
  bool isDone() const override { return m_Index == m_List.size(); }
  const HxCSrcRef* currentItem() const override {
    if (isDone()) throw kBehindTheEnd;
    return m_List[m_Index];
  }

 private:
  const std::vector<const HxCSrcRef*>& m_List;  // of the set
  std::size_t m_Index = 0;
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
  m_Content.list->push_back(srcRef);
}

bool HxCSrcRefSet::contains(const HxCSrcRef* srcRef) const {
  if (m_IsSingle) return m_Content.one == srcRef;
  const auto end = m_Content.list->end();
  return std::find(m_Content.list->begin(), end, srcRef) != end;
}

void HxCSrcRefSet::changeToList() {
  auto* list = new List;
  list->reserve(kFirstCapacity);
  list->push_back(m_Content.one);
  m_Content.list = list;
  m_IsSingle = false;
}

int HxCSrcRefSet::getSrcRefCnt() const {
  if (!m_IsSingle) return static_cast<int>(m_Content.list->size());
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
