// A locale in which careless code goes wrong.
//
//   {
//     const HX_ForeignLocale foreign;
//     server.printCurrentResults("");   // must write 0.5, not 0,5
//   }

#ifndef SUPPORT_HX_FOREIGNLOCALE_H
#define SUPPORT_HX_FOREIGNLOCALE_H

#include <locale>

/// Turkish in ISO-8859-9 for C and C++, while the object lives. Numbers have a
/// decimal comma, streams group digits by '.', 'i' and 'I' are no pair of
/// letter cases, bytes above 127 are letters, months have Turkish names.
///
/// The build makes the locale with localedef. Throws std::runtime_error if the
/// locale is missing: a test without the locale proves nothing.
class HX_ForeignLocale {
 public:
  HX_ForeignLocale();
  HX_ForeignLocale(const HX_ForeignLocale&) = delete;
  HX_ForeignLocale& operator=(const HX_ForeignLocale&) = delete;
  ~HX_ForeignLocale();

 private:
  std::locale m_Previous;
};

#endif  // SUPPORT_HX_FOREIGNLOCALE_H
