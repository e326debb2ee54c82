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
#if defined(_WIN32)
  const char* const name = "Turkish_Turkey";
#else
  const char* const name = "tr_TR";
  setenv("LOCPATH", HX_LOCALES, 1);
#endif
  if (std::setlocale(LC_ALL, name) == nullptr)
    throw std::runtime_error(std::string("no locale ") + name);
}

HX_ForeignLocale::~HX_ForeignLocale() { std::locale::global(m_Previous); }
