#include "NameSpace/HxCXStringIdServer.h"

#include <cstdint>
#include <cstring>

#include "Control/HX_SelfCheck.h"
#include "NameSpace/HX_KeyTable.h"
#include "NameSpace/HX_PlainArray.h"
#include "NameSpace/implNameSpace/HX_TextHash.h"
#include "platform/strings/KyCXString.h"

namespace {

constexpr char kErrorCode[] = __FILE__ "_";
constexpr unsigned kBucketBits = 10;
constexpr unsigned kBucketCount = 1U << kBucketBits;

// Followed in the same block by the text and its terminating zero.
struct StringEntry {
  std::int32_t length;  // without the zero
  std::int32_t id;

  char* text() { return reinterpret_cast<char*>(this + 1); }
};

unsigned bucketOf(const char* text, std::size_t length) {
  unsigned sum = 0;
  for (std::size_t i = 0; i < length; ++i)
    sum += static_cast<unsigned>(static_cast<signed char>(text[i]));
  return sum % kBucketCount;
}

StringEntry* newEntry(unsigned id, const char* text, std::size_t length) {
  void* block = HX_Allocate(sizeof(StringEntry) + length + 1);
  if (block == nullptr) return nullptr;
  auto* entry = static_cast<StringEntry*>(block);
  entry->length = static_cast<std::int32_t>(length);
  entry->id = static_cast<std::int32_t>(id);
  std::memcpy(entry->text(), text, length);
  entry->text()[length] = 0;
  return entry;
}

}  // namespace

struct HxCXStringIdServer::Table : HX_Allocated {
  Table() = default;
  Table(const Table&) = delete;
  Table& operator=(const Table&) = delete;
  ~Table() {
    for (const auto& bucket : m_Buckets)
      for (StringEntry* entry : bucket) HX_Free(entry);
  }

  StringEntry* find(int hash, const char* text, std::size_t length) const {
    const auto* slot = m_Index.find(hash, [=](StringEntry* entry) {
      return static_cast<std::size_t>(entry->length) == length &&
             std::memcmp(entry->text(), text, length) == 0;
    });
    return slot == nullptr ? nullptr : slot->value;
  }

  // Null, with nothing changed, if there is no memory.
  StringEntry* add(int hash, const char* text, std::size_t length) {
    const unsigned number = bucketOf(text, length);
    auto& bucket = m_Buckets[number];
    StringEntry* entry =
        newEntry(number + (bucket.size() << kBucketBits), text, length);
    if (entry == nullptr) return nullptr;
    if (bucket.append(entry)) {
      if (m_Index.add(hash, entry) != nullptr) return entry;
      bucket.dropLast();
    }
    HX_Free(entry);
    return nullptr;
  }

  // Strings of one bucket in the order of arrival, which is the id's upper
  // part.
  HX_PlainArray<StringEntry*> m_Buckets[kBucketCount];
  HX_KeyTable<StringEntry*> m_Index;  // by the hash of the text
};

bool HxCXStringIdServer::boot() {
  if (m_pTable == nullptr) m_pTable = new Table;
  return true;
}

bool HxCXStringIdServer::shutdown() {
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
  const StringEntry* entry = m_pTable->find(hash, text, length);
  if (entry == nullptr) entry = m_pTable->add(hash, text, length);
  if (entry == nullptr) return false;
  id = entry->id;
  return true;
}

const char* HxCXStringIdServer::getString(int id) {
  if (!HX_Assert(m_pTable != nullptr, kErrorCode)) return nullptr;
  const unsigned bits = static_cast<unsigned>(id);
  const auto& bucket = m_pTable->m_Buckets[bits % kBucketCount];
  const unsigned arrival = bits >> kBucketBits;
  return arrival < bucket.size() ? bucket[arrival]->text() : nullptr;
}
