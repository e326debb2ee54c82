// Every row of the catalogue with arbitrary arguments.
#include <cstdio>
#include <cstdlib>
#include <iterator>

#include "Control/ERR_Messages.h"
#include "SourceRef/HxCBlockSrcRef.h"
#include "fuzz/HX_Fuzz.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/model/HX_Block.h"

namespace {

constexpr int kRows = static_cast<int>(std::size(kErrCatalogue));
constexpr ERR_CatalogueRow kUnknown{4711, 0, "", 0, ""};

// A row with severity and source; emit() returns the expected text.
struct Report {
  ERR_CatalogueRow row;
  int severity;
  const HxCSrcRef* srcRef;

  template <class... Arguments>
  std::string emit(Arguments... arguments) const {
    char text[10000];
    std::snprintf(text, sizeof text, row.text, arguments...);
    ERR_EmitErrorMessage(severity, srcRef, row.number, arguments...);
    return text;
  }
  // With arguments that fit the row. Surplus texts do no harm.
  std::string emitFrom(HX_Bytes& bytes) const {
    std::string kinds, lines[4];
    const char* rest = row.text;
    while (const char kind = err_detail::nextConversion(rest)) kinds += kind;
    for (std::string& line : lines) line = bytes.line().substr(0, 1500);
    const auto text = [&](int i) { return lines[i].c_str(); };
    const auto number = [&](int i) { return std::strtod(text(i), nullptr); };
    if (kinds == "sd") return emit(text(0), std::atoi(text(1)));
    if (kinds == "sf") return emit(text(0), number(1));
    if (kinds == "ssff") return emit(text(0), text(1), number(2), number(3));
    HX_Require(kinds.find_first_not_of('s') == kinds.npos, "known " + kinds);
    return emit(text(0), text(1), text(2), text(3));
  }
};

}  // namespace

void HX_CheckMessages(HX_Bytes& bytes) {
  HX_MessageHandler& handler = HX_MessageHandler::instance();
  handler.clear();
  int worst = 0;
  while (!bytes.isEmpty()) {
    const int index = bytes.below(kRows + 1);
    const int severity = bytes.number() - 128;
    const bool hasSource = bytes.flag();
    const HX_Block block(bytes.text());
    const Report report{index < kRows ? kErrCatalogue[index] : kUnknown,
                        severity, hasSource ? block.getSrcRef() : nullptr};
    const std::string text = report.emitFrom(bytes);

    const HX_Message& message = handler.messages().back();
    HX_Require(message.text == text, "text " + text);
    HX_Require(message.row == report.row.number && message.id == report.row.id,
               "numbers");
    KyCXString source(hasSource ? block.getName() : KyCXString());
    source.replaceWhiteSpace(' ', false);
    HX_Require(message.source == source.cstring(), "source");
    worst = std::max(worst, severity & 3);
    HX_Require(ERR_get_errstatus() == worst, "the status is the worst so far");
  }
  handler.clear();
}
