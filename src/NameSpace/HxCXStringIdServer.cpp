// Problem: one id per distinct text, where the id must be bucket + 1024 * k for
// the k-th text of the bucket, and names of a model often share a bucket: the
// character sum of x12 and x21 is the same.
//
// Plain form: 1024 lists, searched one by one; n names of one sum take n^2 / 2
// comparisons of texts.
//
// Idea: two structures over the same texts.
//   index    hash table, hash of the text -> id: finds the id of a text
//   buckets  per bucket an array of texts in the order of arrival: finds the
//            text of an id, and its size gives the next id
//
// Example: "ab", "ba", "c" on a fresh server
//   bucket 195: "ab" "ba"   ids 195, 1219
//   bucket 99:  "c"         id 99
//   getString(1219): bucket 1219 % 1024 = 195, arrival 1219 / 1024 = 1
//
// Invariants: 1. buckets[b][k] is the text of id b + 1024 * k, and the index
// holds the id. 2. Every text is in one bucket. 3. A text stays at its address
// (HX_TextArena) until shutdown().
//
// Test: StringIdServerTest.AgreesWithPlainBuckets.

#include "NameSpace/HxCXStringIdServer.h"

#include <cstring>

#include "Control/HX_SelfCheck.h"
#include "implContainers/HX_HashTable.h"
#include "implContainers/HX_TextArena.h"
#include "implContainers/HX_TextHash.h"
#include "platform/strings/KyCXString.h"

namespace {

constexpr char kIdServerErrorCode[] = __FILE__ "_";

}  // namespace

struct HxCXStringIdServer::Table : Buckets {
  HX_HashTable<int, int> index;  // ids by the hash of the text
  HX_TextArena texts;
};

bool HxCXStringIdServer::boot() {
  if (m_pTable == nullptr) m_pTable = new Table;
  return true;
}

bool HxCXStringIdServer::shutdown() {
  if (m_pTable != nullptr) delete &table();
  m_pTable = nullptr;
  return true;
}

int HxCXStringIdServer::getId(const KyCXString& s) {
  int id = 0;
  findOrAdd(s, id);
  return id;
}

int HxCXStringIdServer::getId(const KyCXString* s) {
  return HX_Assert(s != nullptr, kIdServerErrorCode) ? getId(*s) : 0;
}

bool HxCXStringIdServer::findOrAdd(const KyCXString& s, int& id) {
  if (!HX_Assert(m_pTable != nullptr, kIdServerErrorCode)) return false;
  if (s.isEmpty()) {
    id = 0;
    return true;
  }
  const char* const text = s.cstring();
  const std::size_t length = std::strlen(text);
  const int hash = HX_TextHash(text, length);
  const auto* slot = table().index.find(hash, [=, this](int known) {
    return std::strcmp(getString(known), text) == 0;
  });
  if (slot == nullptr) return add(hash, text, length, id);
  id = slot->value;
  return true;
}

HxCXStringIdServer::Table& HxCXStringIdServer::table() const {
  return *static_cast<Table*>(m_pTable);
}

unsigned HxCXStringIdServer::bucketOf(const char* text, std::size_t length) {
  unsigned sum = 0;
  for (std::size_t i = 0; i < length; ++i)
    sum += static_cast<unsigned>(static_cast<signed char>(text[i]));
  return sum % kBucketCount;
}

// RETURNS: false, with nothing changed, without memory.
bool HxCXStringIdServer::add(int hash, const char* text, std::size_t length,
                             int& id) {
  const unsigned number = bucketOf(text, length);
  Bucket& bucket = m_pTable->buckets[number];
  const int newId = static_cast<int>(number + bucket.size() * kBucketCount);
  const char* const kept = table().texts.add(text, length);
  if (kept == nullptr) return false;
  if (bucket.append(kept)) {
    if (table().index.add(hash, newId) != nullptr) {
      id = newId;
      return true;
    }
    bucket.dropLast();
  }
  table().texts.dropLast(length);
  return false;
}

const char* HxCXStringIdServer::refuseText() {
  HX_Assert(false, kIdServerErrorCode);
  return nullptr;
}
