// The messages that this library emits, one row each.
//
// A new message is a new row here. The row makes two things: the entry of the
// catalogue, for message handlers, and the emitter ERR_Msg<number> in
// ERR_Messages.h. The compiler checks every row: numbers ascend, and parameters
// of the emitter fit the conversions of the text.

#ifndef CONTROL_ERR_CATALOGUE_H
#define CONTROL_ERR_CATALOGUE_H

/// One message: number, identification, class and wording.
struct ERR_CatalogueRow {
  int number;            ///< for ERR_EmitErrorMessage()
  int id;                ///< the number shown to users
  const char* category;  ///< the group shown to users
  int severity;          ///< 0 to 7, see ERR_EmitErrorMessage()
  const char* text;      ///< a printf format
};

/// The groups of messages, as a user reads them.
inline constexpr const char* kGeneralMessages = "General Messages";
inline constexpr const char* kSystemMessages = "Operating System Messages";
inline constexpr const char* kCompileMessages = "Compile Time Messages";
inline constexpr const char* kVariableMessages = "Variables Messages";
inline constexpr const char* kNamingMessages = "Naming Macros Messages";
inline constexpr const char* kInternalMessages = "Internals message";

/// Calls ROW for every message, ascending by number, with: number, id,
/// category, severity, parameters of the emitter, the same parameters without
/// types, text. An emitter whose first parameter is a source reference attaches
/// the message to that reference.
#define ERR_MESSAGES(ROW)                                                      \
  ROW(2, 10002, kGeneralMessages, 0, (const char* label, double seconds),      \
      (label, seconds), "%-30s in %7.3lf seconds.")                            \
  ROW(7, 10007, kGeneralMessages, 3, (const char* fileCode, int line),         \
      (fileCode, line),                                                        \
      "Internal error. Error code: %s%d. Please report it to the support, "    \
      "with the model if you can.")                                            \
  ROW(90, 10651, kSystemMessages, 3, (const char* fileName), (fileName),       \
      "Cannot create file: %s.")                                               \
  ROW(403, 17051, kCompileMessages, 2, (const char* kind, const char* list),   \
      (kind, list),                                                            \
      "Found unresolvable dependencies between the following %s : %s. Modify " \
      "your modeling.")                                                        \
  ROW(408, 17056, kCompileMessages, 2, (const char* name), (name),             \
      "C keyword %s used as identifier.")                                      \
  ROW(409, 17057, kCompileMessages, 2, (const char* name), (name),             \
      "Base type name %s used as identifier.")                                 \
  ROW(410, 17058, kCompileMessages, 2, (const char* name), (name),             \
      "User data type name %s used as identifier.")                            \
  ROW(503, 17260, kVariableMessages, 1, (const HxCSrcRef* srcRef), (srcRef),   \
      "A template name is empty.")                                             \
  ROW(1202, 30303, kNamingMessages, 1,                                         \
      (const HxCSrcRef* srcRef, const char* macro, const char* nameTemplate),  \
      (srcRef, macro, nameTemplate),                                           \
      "The %s name macro in the %s name template is not supported here. It "   \
      "is ignored.")                                                           \
  ROW(1203, 30304, kNamingMessages, 1,                                         \
      (const HxCSrcRef* srcRef, const char* macro, const char* nameTemplate),  \
      (srcRef, macro, nameTemplate),                                           \
      "The %s name macro in the %s name template is unknown. It is ignored.")  \
  ROW(1204, 30305, kNamingMessages, 2,                                         \
      (const HxCSrcRef* srcRef, const char* nameTemplate),                     \
      (srcRef, nameTemplate),                                                  \
      "The $Task name macro is used in the task name template %s. This is "    \
      "not allowed.")                                                          \
  ROW(1205, 30306, kNamingMessages, 2,                                         \
      (const HxCSrcRef* srcRef, const char* nameTemplate),                     \
      (srcRef, nameTemplate),                                                  \
      "A time/period/offset name macro is used in a noncyclic task. Name "     \
      "template: %s")                                                          \
  ROW(1206, 30307, kNamingMessages, 1,                                         \
      (const HxCSrcRef* srcRef, const char* macro, const char* timeBase,       \
       double period, double offset),                                          \
      (srcRef, macro, timeBase, period, offset),                               \
      "A time name macro '%s' with the time base %s is used. The period time " \
      "%f or offset %f cannot be represented precisely with this time base.")  \
  ROW(1207, 30308, kNamingMessages, 1,                                         \
      (const HxCSrcRef* srcRef, const char* kind, const char* value),          \
      (srcRef, kind, value),                                                   \
      "The %s %s cannot be represented precisely with the $(Time) name "       \
      "macro.")                                                                \
  ROW(1209, 30310, kNamingMessages, 1, (const HxCSrcRef* srcRef), (srcRef),    \
      "The $(Component) name macro could not substitute")                      \
  ROW(1210, 30311, kNamingMessages, 2,                                         \
      (const HxCSrcRef* srcRef, const char* firstProperty,                     \
       const char* firstComponent, const char* secondProperty,                 \
       const char* secondComponent),                                           \
      (srcRef, firstProperty, firstComponent, secondProperty,                  \
       secondComponent),                                                       \
      "The variable was referenced first through the RelatedVariables "        \
      "property %s of software component %s and second by the "                \
      "RelatedVariables property %s of software component %s.")                \
  ROW(1272, 99000, kInternalMessages, 4,                                       \
      (const HxCSrcRef* srcRef, const char* text), (srcRef, text), "%s.")      \
  ROW(1273, 99001, kInternalMessages, 5,                                       \
      (const HxCSrcRef* srcRef, const char* text), (srcRef, text), "%s.")      \
  ROW(1274, 99002, kInternalMessages, 6,                                       \
      (const HxCSrcRef* srcRef, const char* text), (srcRef, text), "%s.")      \
  ROW(1275, 99003, kInternalMessages, 7,                                       \
      (const HxCSrcRef* srcRef, const char* text), (srcRef, text), "%s.")      \
  ROW(1292, 99023, kInternalMessages, 5, (const char* text), (text),           \
      "INTERNAL: %s")

/// A message as a row of the table.
#define ERR_ROW(number, id, category, severity, parameters, arguments, text) \
  {number, id, category, severity, text},

/// Ascending by number.
inline constexpr ERR_CatalogueRow kErrCatalogue[] = {ERR_MESSAGES(ERR_ROW)};
#undef ERR_ROW

/// The index of the row with this number, -1 if the library does not emit it.
constexpr int ERR_FindIndex(int number) {
  int index = 0;
  for (const ERR_CatalogueRow& row : kErrCatalogue) {
    if (row.number == number) return index;
    ++index;
  }
  return -1;
}

/// The row with this number, null if the library does not emit it.
constexpr const ERR_CatalogueRow* ERR_FindRow(int number) {
  const int index = ERR_FindIndex(number);
  return index < 0 ? nullptr : &kErrCatalogue[index];
}

#endif  // CONTROL_ERR_CATALOGUE_H
