#include "support/HX_ForeignLocale.h"

#include <stdlib.h>

#include <clocale>
#include <stdexcept>
#include <string>

namespace {

// Not std::locale("tr_TR"): newlocale() leaks the value of LOCPATH.
struct TurkishNumbers : std::numpunct<char> {
  char do_decimal_point() const override { return ','; }
  char do_thousands_sep() const override { return '.'; }
  std::string do_grouping() const override { return "\3"; }
};

}  // namespace

HX_ForeignLocale::HX_ForeignLocale()
    : m_Previous(std::locale::global(
          std::locale(std::locale::classic(), new TurkishNumbers))) {
  setenv("LOCPATH", HX_LOCALES, 1);
  if (std::setlocale(LC_ALL, "tr_TR") == nullptr)
    throw std::runtime_error("no locale tr_TR in " HX_LOCALES);
}

HX_ForeignLocale::~HX_ForeignLocale() { std::locale::global(m_Previous); }
