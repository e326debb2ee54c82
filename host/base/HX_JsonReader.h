// Reads JSON as a sequence of events: no tree, no recursion over the depth.
//
//   struct Counter : HX_JsonEvents { ... };
//   Counter counter;
//   const HX_JsonEnd end = HX_ReadJson("[1, 2]", counter);
//   // end.isComplete()

#ifndef HOST_BASE_HX_JSONREADER_H
#define HOST_BASE_HX_JSONREADER_H

#include <cstddef>
#include <string_view>

/// A value without parts.
struct HX_JsonValue {
  enum HxEKindTag { eNull, eBoolean, eWhole, eFraction, eText };

  HxEKindTag kind = eNull;
  bool boolean = false;
  double number = 0;      // of eWhole, also beyond 2^53, and of eFraction
  std::string_view text;  // UTF-8, a zero behind the end; valid in the event
};

/// Receives the events of a document. An answer false ends the reading.
class HX_JsonEvents {
 public:
  virtual ~HX_JsonEvents() = default;
  /// \param end  position behind the token, in bytes from the start; names the
  ///             token, since no two tokens have the same end
  virtual bool value(const HX_JsonValue& value, std::size_t end) = 0;
  virtual bool key(std::string_view text, std::size_t end) = 0;
  virtual bool beginObject(std::size_t end) = 0;
  virtual bool endObject(std::size_t end) = 0;
  virtual bool beginList(std::size_t end) = 0;
  virtual bool endList(std::size_t end) = 0;
};

/// How the reading of a text ended.
struct HX_JsonEnd {
  const char* expected = nullptr;  // null for a complete document
  std::size_t place = 0;           // of the fault, in bytes
  bool isStopped = false;          // by an answer false; no fault

  bool isComplete() const { return expected == nullptr && !isStopped; }
};

/// Reads one JSON value (RFC 8259) in UTF-8, with or without a byte order mark.
/// Numbers outside the range of double, unpaired surrogates, ill-formed UTF-8
/// and text behind the value are faults. Throws std::bad_alloc.
HX_JsonEnd HX_ReadJson(std::string_view text, HX_JsonEvents& events);

#endif  // HOST_BASE_HX_JSONREADER_H
