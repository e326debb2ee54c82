#include "NameSpace/HxCXStringIdServer.h"

#include <algorithm>
#include <cstring>

#include "Control/HX_SelfCheck.h"
#include "NameSpace/implNameSpace/HX_TextHash.h"
#include "platform/strings/KyCXString.h"

namespace {

constexpr char kErrorCode[] = __FILE__ "_";

}  // namespace

bool HxCXStringIdServer::boot() {
  if (m_pTable == nullptr) m_pTable = new Table;
  return true;
}

bool HxCXStringIdServer::shutdown() {
  if (m_pTable == nullptr) return true;
  HX_Free(m_pTable->nearTexts);
  delete m_pTable;
  m_pTable = nullptr;
  return true;
}

int HxCXStringIdServer::getId(const KyCXString& s) {
  int id = 0;
  findOrAdd(s, id);
  return id;
}

int HxCXStringIdServer::getId(const KyCXString* s) {
  return HX_Assert(s != nullptr, kErrorCode) ? getId(*s) : 0;
}

bool HxCXStringIdServer::findOrAdd(const KyCXString& s, int& id) {
  if (!HX_Assert(m_pTable != nullptr, kErrorCode)) return false;
  if (s.isEmpty()) {
    id = 0;
    return true;
  }
  const char* const text = s.cstring();
  const std::size_t length = std::strlen(text);
  const int hash = HX_TextHash(text, length);
  const auto* slot = m_pTable->index.find(hash, [=, this](int known) {
    return std::strcmp(getString(known), text) == 0;
  });
  if (slot == nullptr) return add(hash, text, length, id);
  id = slot->value;
  return true;
}

unsigned HxCXStringIdServer::bucketOf(const char* text, std::size_t length) {
  unsigned sum = 0;
  for (std::size_t i = 0; i < length; ++i)
    sum += static_cast<unsigned>(static_cast<signed char>(text[i]));
  return sum % kBucketCount;
}

// False, with nothing changed, if there is no memory.
bool HxCXStringIdServer::add(int hash, const char* text, std::size_t length,
                             int& id) {
  const unsigned number = bucketOf(text, length);
  unsigned& arrivals = m_pTable->buckets[number].arrivals;
  const unsigned newId = number + arrivals * kBucketCount;
  const char* const kept = m_pTable->texts.add(text, length);
  if (kept == nullptr) return false;
  auto* slot = m_pTable->index.add(hash, static_cast<int>(newId));
  if (slot != nullptr && keepText(newId, kept)) {
    ++arrivals;
    id = static_cast<int>(newId);
    return true;
  }
  if (slot != nullptr) m_pTable->index.erase(slot);
  m_pTable->texts.dropLast(length);
  return false;
}

// False, with nothing changed, if there is no memory.
bool HxCXStringIdServer::keepText(unsigned id, const char* text) {
  Table& table = *m_pTable;
  if (id >= table.nearSize && table.nearUsed >= table.nearSize / 2) growNear();
  const bool isNear = id < table.nearSize;
  Bucket& bucket = table.buckets[id % kBucketCount];
  if (!isNear || bucket.farTexts.size() != 0) {
    if (bucket.farTexts.size() == 0) bucket.firstFar = bucket.arrivals;
    if (!bucket.farTexts.append(text)) return false;
  }
  if (!isNear) return true;
  table.nearTexts[id] = text;
  ++table.nearUsed;
  return true;
}

// Without memory, everything stays as it is.
void HxCXStringIdServer::growNear() {
  Table& table = *m_pTable;
  const unsigned newSize =
      table.nearSize == 0 ? 2 * kBucketCount : 2 * table.nearSize;
  void* const room = HX_Allocate(newSize * sizeof(char*));
  if (room == nullptr) return;
  auto** const texts = static_cast<const char**>(room);
  std::copy_n(table.nearTexts, table.nearSize, texts);
  std::fill(texts + table.nearSize, texts + newSize, nullptr);
  HX_Free(table.nearTexts);
  table.nearTexts = texts;
  table.nearSize = newSize;
  for (unsigned number = 0; number < kBucketCount; ++number)
    fillNear(table.buckets[number], number);
}

// Enters the far texts of a bucket that are near by now.
void HxCXStringIdServer::fillNear(const Bucket& bucket, unsigned number) {
  unsigned id = number + bucket.firstFar * kBucketCount;
  for (const char* text : bucket.farTexts) {
    if (id >= m_pTable->nearSize) return;
    if (m_pTable->nearTexts[id] == nullptr) ++m_pTable->nearUsed;
    m_pTable->nearTexts[id] = text;
    id += kBucketCount;
  }
}

const char* HxCXStringIdServer::textFarOff(int id) const {
  const unsigned bits = static_cast<unsigned>(id);
  const Bucket& bucket = m_pTable->buckets[bits % kBucketCount];
  const unsigned place = bits / kBucketCount - bucket.firstFar;
  return place < bucket.farTexts.size() ? bucket.farTexts[place] : nullptr;
}

const char* HxCXStringIdServer::refuseText() {
  HX_Assert(false, kErrorCode);
  return nullptr;
}
