// String interning: one integer id per distinct string.
//
// Scopes key their names by ids, so a lookup in a scope compares integers. The
// low ten bits of an id are the bucket of the string: the sum of its
// characters. The bits above count the strings that the bucket held before.
//
//   HxCXStringIdServer ids;
//   ids.boot();
//   ids.getId("ab");       // 195 = 'a' + 'b'
//   ids.getId("ba");       // 1219, the second arrival in bucket 195
//   ids.getString(1219);   // "ba"
//   ids.shutdown();

#ifndef NAMESPACE_HXCXSTRINGIDSERVER_H
#define NAMESPACE_HXCXSTRINGIDSERVER_H

#include <cstddef>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "implContainers/HX_PlainArray.h"

class KyCXString;

/// Down after construction.
///
/// OWNERSHIP: shutdown() frees all strings, the destructor frees nothing. A
/// copy shares the strings of the original: boot before copying, and shut down
/// only the original or the copy.
///
/// Strings with equal 8-bit forms up to the first zero share an id, also
/// strings that differ only in characters shown as '?'. A bucket counts four
/// million strings. Without memory no operation throws.
class HX_UTILS_API HxCXStringIdServer : public HX_Allocated {
 public:
  /// Makes the server ready; a server that is up keeps its strings.
  /// RETURNS: true, even if the server stays down for want of memory.
  bool boot();

  /// Forgets all strings; ids start afresh after the next boot().
  /// RETURNS: true, also for a server that is down.
  bool shutdown();

  /// False before boot() and after shutdown().
  bool isUp() const { return m_pTable != nullptr; }

  /// Adds \p s if \p s is new. The id is the bucket (the sum of the characters
  /// as signed values, modulo 1024, in [0, 1023]) plus 1024 times the number of
  /// strings that the bucket held before. The empty string has id 0 and is not
  /// stored; a stored string may have id 0 as well.
  ///
  /// RETURNS: the id; 0 if the server is down or \p s is null (internal
  /// assertion), or without memory.
  int getId(const KyCXString& s);
  int getId(const KyCXString* s);

  /// getId() for callers who must tell a failure from the id 0.
  /// \param[out] id  written on success
  /// RETURNS: false where getId() fails.
  bool findOrAdd(const KyCXString& s, int& id);

  /// RETURNS: the 8-bit form of the string with \p id, valid until shutdown();
  /// null for an unknown id; null after an internal assertion if the server is
  /// down.
  const char* getString(int id) const {
    if (m_pTable == nullptr) return refuseText();
    const unsigned bits = static_cast<unsigned>(id);
    const Bucket& bucket = m_pTable->buckets[bits % kBucketCount];
    const unsigned arrival = bits / kBucketCount;
    return arrival < bucket.size() ? bucket[arrival] : nullptr;
  }

 private:
  static constexpr unsigned kBucketCount = 1024;

  using Bucket = HX_PlainArray<const char*>;  // in the order of arrival

  // Part of the table for getString().
  struct Buckets : HX_Allocated {
    Bucket buckets[kBucketCount];
  };
  struct Table;

  Table& table() const;
  static unsigned bucketOf(const char* text, std::size_t length);
  bool add(int hash, const char* text, std::size_t length, int& id);
  static const char* refuseText();

  Buckets* m_pTable = nullptr;  // a Table; null while down
};

#endif  // NAMESPACE_HXCXSTRINGIDSERVER_H
