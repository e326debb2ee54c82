#include "support/HX_ForeignLocale.h"

#include <stdlib.h>

HX_ForeignLocale::HX_ForeignLocale() {
  setenv("LOCPATH", HX_LOCALES, 1);
  m_Previous = std::locale::global(std::locale("tr_TR"));
}

HX_ForeignLocale::~HX_ForeignLocale() { std::locale::global(m_Previous); }
