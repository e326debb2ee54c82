#include "host/base/HX_JsonReader.h"

#include <rapidjson/memorystream.h>
#include <rapidjson/reader.h>

#include <cstdint>

#include "host/base/HX_CheckedAllocator.h"

namespace {

/// Turns the calls of the parser into events.
class Adapter {
 public:
  Adapter(const rapidjson::MemoryStream& stream, std::size_t skipped,
          HX_JsonEvents& events)
      : m_Stream(stream), m_Skipped(skipped), m_Events(events) {}

  // The names are those that the parser calls.
  bool Null() { return pass({}); }
  bool Bool(bool value) {
    HX_JsonValue event;
    event.kind = HX_JsonValue::eBoolean;
    event.boolean = value;
    return pass(event);
  }
  bool Int(int value) { return whole(value); }
  bool Uint(unsigned value) { return whole(value); }
  bool Int64(std::int64_t value) { return whole(static_cast<double>(value)); }
  bool Uint64(std::uint64_t value) { return whole(static_cast<double>(value)); }
  bool Double(double value) {
    HX_JsonValue event;
    event.kind = HX_JsonValue::eFraction;
    event.number = value;
    return pass(event);
  }
  bool RawNumber(const char*, rapidjson::SizeType, bool) { return false; }
  bool String(const char* text, rapidjson::SizeType length, bool) {
    HX_JsonValue event;
    event.kind = HX_JsonValue::eText;
    event.text = {text, length};
    return pass(event);
  }
  bool Key(const char* text, rapidjson::SizeType length, bool) {
    return m_Events.key({text, length}, end());
  }
  bool StartObject() { return m_Events.beginObject(end()); }
  bool EndObject(rapidjson::SizeType) { return m_Events.endObject(end()); }
  bool StartArray() { return m_Events.beginList(end()); }
  bool EndArray(rapidjson::SizeType) { return m_Events.endList(end()); }

 private:
  std::size_t end() const { return m_Stream.Tell() + m_Skipped; }
  bool pass(const HX_JsonValue& event) { return m_Events.value(event, end()); }
  bool whole(double value) {
    HX_JsonValue event;
    event.kind = HX_JsonValue::eWhole;
    event.number = value;
    return pass(event);
  }

  const rapidjson::MemoryStream& m_Stream;
  std::size_t m_Skipped;  // bytes in front of the stream
  HX_JsonEvents& m_Events;
};

const char* expectationAt(rapidjson::ParseErrorCode code) {
  switch (code) {
    case rapidjson::kParseErrorDocumentEmpty:
      return "a JSON document";
    case rapidjson::kParseErrorDocumentRootNotSingular:
      return "the end of the document";
    case rapidjson::kParseErrorObjectMissName:
      return "a field name in quotation marks";
    case rapidjson::kParseErrorObjectMissColon:
      return "':' after the field name";
    case rapidjson::kParseErrorObjectMissCommaOrCurlyBracket:
      return "',' or '}' after the field";
    case rapidjson::kParseErrorArrayMissCommaOrSquareBracket:
      return "',' or ']' after the element";
    case rapidjson::kParseErrorStringUnicodeEscapeInvalidHex:
      return "four hexadecimal digits after \\u";
    case rapidjson::kParseErrorStringUnicodeSurrogateInvalid:
      return "a pair of surrogates";
    case rapidjson::kParseErrorStringEscapeInvalid:
      return "an escape of JSON, also for control characters";
    case rapidjson::kParseErrorStringMissQuotationMark:
      return "a text that a quotation mark ends, without control characters";
    case rapidjson::kParseErrorStringInvalidEncoding:
      return "text in UTF-8";
    case rapidjson::kParseErrorNumberTooBig:
      return "a number in the range of double";
    case rapidjson::kParseErrorNumberMissFraction:
      return "digits after the decimal point";
    case rapidjson::kParseErrorNumberMissExponent:
      return "digits of an exponent";
    default:
      return "a value of JSON";
  }
}

}  // namespace

HX_JsonEnd HX_ReadJson(std::string_view text, HX_JsonEvents& events) {
  constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
  constexpr unsigned kFlags = rapidjson::kParseIterativeFlag |
                              rapidjson::kParseValidateEncodingFlag |
                              rapidjson::kParseFullPrecisionFlag;
  const std::size_t skipped =
      text.starts_with(kByteOrderMark) ? kByteOrderMark.size() : 0;
  rapidjson::MemoryStream stream(text.data() + skipped, text.size() - skipped);
  Adapter adapter(stream, skipped, events);
  rapidjson::GenericReader<rapidjson::UTF8<>, rapidjson::UTF8<>,
                           HX_CheckedAllocator>
      reader;
  const rapidjson::ParseResult result = reader.Parse<kFlags>(stream, adapter);
  HX_JsonEnd end;
  if (result.Code() == rapidjson::kParseErrorTermination) {
    end.isStopped = true;
  } else if (result.IsError()) {
    end.expected = expectationAt(result.Code());
    end.place = result.Offset() + skipped;
  } else if (stream.Tell() + skipped < text.size()) {
    // For the parser a zero ends the text.
    end.expected = "the end of the document";
    end.place = stream.Tell() + skipped;
  }
  return end;
}
