#include "SourceRef/HxCSrcRefSet.h"

#include <algorithm>
#include <cstddef>

namespace {

using SrcRefIterator = HX_Iterator<const HxCSrcRef*>;

constexpr int kBehindTheEnd = -1;          // thrown by currentItem()
constexpr std::size_t kFirstCapacity = 4;  // few items have more references

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

template <class List>
class ListIterator : public SrcRefIterator {
 public:
  explicit ListIterator(const List& list) : m_List(list) {}

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
  const List& m_List;  // of the set
  std::size_t m_Index = 0;
};

}  // namespace

HxCSrcRefSet& HxCSrcRefSet::operator=(const HxCSrcRefSet& other) {
  if (this == &other) return *this;
  if (other.getSrcRefCnt() < 2) {
    const HxCSrcRef* const one = other.getASrcRef();
    clear();
    m_Content.one = one;
    return *this;
  }
  List* const copy = HX_WithinMemory<List*>(
      nullptr, [&] { return new List(*other.m_Content.list); });
  if (copy == nullptr) return *this;
  clear();
  m_Content.list = copy;
  m_IsSingle = false;
  return *this;
}

void HxCSrcRefSet::addSrcRef(const HxCSrcRefSet& other) {
  if (this == &other) return;
  const int count = getSrcRefCnt();
  bool isComplete = true;
  other.forEach([&](const HxCSrcRef* srcRef) {
    if (m_IsSingle && m_Content.one == nullptr)
      m_Content.one = srcRef;
    else
      isComplete = isComplete && addToNonEmpty(srcRef);
  });
  if (!isComplete) keepFirst(count);
}

bool HxCSrcRefSet::addToNonEmpty(const HxCSrcRef* srcRef) {
  return srcRef == nullptr || contains(srcRef) || appendNew(srcRef);
}

bool HxCSrcRefSet::appendNew(const HxCSrcRef* srcRef) {
  if (!m_IsSingle) {
    auto& refs = m_Content.list->refs;
    const std::size_t size = refs.size();
    if (size == refs.capacity() &&
        !HX_WithinMemory([&refs, size] { refs.reserve(2 * size); }))
      return false;
    refs.push_back(srcRef);
    return true;
  }
  if (m_Content.one == nullptr) {
    m_Content.one = srcRef;
    return true;
  }
  List* const list = new List;
  if (list == nullptr) return false;
  if (!HX_WithinMemory([&] { list->refs.reserve(kFirstCapacity); })) {
    delete list;
    return false;
  }
  list->refs.push_back(m_Content.one);
  list->refs.push_back(srcRef);
  m_Content.list = list;
  m_IsSingle = false;
  return true;
}

bool HxCSrcRefSet::contains(const HxCSrcRef* srcRef) const {
  if (m_IsSingle) return m_Content.one == srcRef;
  const auto& refs = m_Content.list->refs;
  return std::find(refs.begin(), refs.end(), srcRef) != refs.end();
}

void HxCSrcRefSet::keepFirst(int count) {
  if (count == 0)
    clear();
  else if (!m_IsSingle)
    m_Content.list->refs.resize(static_cast<std::size_t>(count));
}

int HxCSrcRefSet::getSrcRefCnt() const {
  if (!m_IsSingle) return static_cast<int>(m_Content.list->refs.size());
  return m_Content.one != nullptr ? 1 : 0;
}

const HxCSrcRef* HxCSrcRefSet::getASrcRef() const {
  return m_IsSingle ? m_Content.one : m_Content.list->refs.front();
}

SrcRefIterator* HxCSrcRefSet::createIterator() const {
  if (!m_IsSingle) return new ListIterator(m_Content.list->refs);
  if (m_Content.one != nullptr) return new SingleIterator(m_Content.one);
  return new EmptyIterator;
}
