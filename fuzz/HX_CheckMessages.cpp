// Each row of the catalogue with arbitrary arguments.
#include <cstdio>
#include <cstdlib>
#include <iterator>

#include "Control/ERR_Messages.h"
#include "SourceRef/HxCBlockSrcRef.h"
#include "fuzz/HX_Fuzz.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/model/HX_Block.h"

namespace {

struct Case {
  HX_Bytes& bytes;
  const HxCSrcRef* srcRef;
  int severity;
  std::string expected;
};

// Reads the arguments from \p position on, then reports.
template <int row, int position, class... Read>
void report(Case& test, Read... read) {
  constexpr ERR_CatalogueRow kRow = kErrCatalogue[row];
  constexpr char kKind = [] {
    const char* text = kRow.text;
    char kind = 0;
    for (int i = 0; i <= position; ++i) kind = err_detail::nextConversion(text);
    return kind;
  }();
  if constexpr (kKind == 0) {
    char text[10000];
    if constexpr (sizeof...(read) != 0)
      std::snprintf(text, sizeof text, kRow.text, read...);
    test.expected = sizeof...(read) != 0 ? text : kRow.text;
    ERR_EmitErrorMessage(test.severity, test.srcRef, kRow.number, read...);
  } else {
    const std::string line = test.bytes.line().substr(0, 1500);
    if constexpr (kKind == 's')
      report<row, position + 1>(test, read..., line.c_str());
    else if constexpr (kKind == 'd')
      report<row, position + 1>(
          test, read...,
          static_cast<int>(std::strtol(line.c_str(), nullptr, 10)));
    else
      report<row, position + 1>(test, read...,
                                std::strtod(line.c_str(), nullptr));
  }
}

template <int... row>
void reportRow(Case& test, int wanted, std::integer_sequence<int, row...>) {
  ((row == wanted ? report<row, 0>(test) : void()), ...);
}

}  // namespace

void HX_CheckMessages(HX_Bytes& bytes) {
  constexpr int kRows = static_cast<int>(std::size(kErrCatalogue));
  HX_MessageHandler& handler = HX_MessageHandler::instance();
  handler.clear();
  int worst = 0;
  while (!bytes.isEmpty()) {
    const int row = bytes.below(kRows + 1);
    const int severity = bytes.number() - 128;
    const bool hasSource = bytes.flag();
    const HX_Block block(bytes.text());
    Case test{bytes, hasSource ? block.getSrcRef() : nullptr, severity, ""};
    const int unknown = 4000 + bytes.number();
    if (row < kRows)
      reportRow(test, row, std::make_integer_sequence<int, kRows>());
    else
      ERR_EmitErrorMessage(severity, test.srcRef, unknown);

    const HX_Message& message = handler.messages().back();
    HX_Require(message.text == test.expected, "text " + test.expected);
    const bool isKnown = row < kRows;
    HX_Require(message.row == (isKnown ? kErrCatalogue[row].number : unknown) &&
                   message.id == (isKnown ? kErrCatalogue[row].id : 0),
               "numbers");
    KyCXString source(hasSource ? block.getName() : KyCXString());
    source.replaceWhiteSpace(' ', false);
    worst = std::max(worst, severity & 3);
    HX_Require(
        message.source == source.cstring() && ERR_get_errstatus() == worst,
        "source, and the status is the worst so far");
  }
  handler.clear();
}
