// Interns strings: one integer id per distinct string.
//
// Scopes key their names by these ids, so that a lookup in a scope compares
// integers. An id carries its bucket, the character sum of the string, in its
// low ten bits and the string's place of arrival in the bucket above them.
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

/// Down after construction. A copy shares the strings of its original: boot
/// before copying, and shut only one of the two down. Destruction does not
/// shut down.
///
/// Strings are told apart by their 8-bit form up to its first zero: two strings
/// that differ only in characters shown as '?' share an id. A bucket counts
/// four million strings.
class HX_UTILS_API HxCXStringIdServer : public HX_Allocated {
 public:
  /// Makes the server ready; a server that is up keeps its strings.
  /// \return true, even if there was no memory and the server stays down
  bool boot();

  /// Forgets all strings; ids start afresh after the next boot(). A server
  /// that is down stays down.
  /// \return true
  bool shutdown();

  /// False before boot() and after shutdown().
  bool isUp() const { return m_pTable != nullptr; }

  /// The id of \p s, which is added if it is new: its bucket (the sum of its
  /// characters as signed values, modulo 1024, not negative) plus 1024 for each
  /// string that the bucket held before. The empty string has id 0 and is not
  /// stored; another string may get id 0 as well.
  ///
  /// 0 if the server is down (internal assertion) or has no memory left.
  int getId(const KyCXString& s);
  int getId(const KyCXString* s);

  /// getId() for callers that must tell its failures from the id 0.
  /// \param[out] id  written on success
  /// \return false where getId() fails
  bool findOrAdd(const KyCXString& s, int& id);

  /// The 8-bit form of the string with \p id, null if there is none. Valid
  /// until shutdown(), however many strings are added. Null after an internal
  /// assertion if the server is down.
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

  // The part of the table that getString() reads.
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
