// The rows of the message catalogue that this library emits.
//
// A new message is a new row here and a new emitter in ERR_Messages.h; the
// compiler checks that the two fit together.

#ifndef CONTROL_ERR_CATALOGUE_H
#define CONTROL_ERR_CATALOGUE_H

/// One message: how it is numbered, classed and worded.
struct ERR_CatalogueRow {
  int number;            ///< what ERR_EmitErrorMessage() receives
  int id;                ///< what a user sees
  const char* category;  ///< the group it is shown in
  int severity;          ///< 0 to 7, see ERR_EmitErrorMessage()
  bool hasSrcRef;        ///< the emitter takes a source reference first
  const char* text;      ///< a printf format
};

/// The groups of messages, as a user reads them.
inline constexpr const char* kGeneralMessages = "General Messages";
inline constexpr const char* kSystemMessages = "Operating System Messages";
inline constexpr const char* kCompileMessages = "Compile Time Messages";
inline constexpr const char* kVariableMessages = "Variables Messages";
inline constexpr const char* kNamingMessages = "Naming Macros Messages";
inline constexpr const char* kInternalMessages = "Internals message";

/// Ascending by number.
inline constexpr ERR_CatalogueRow kErrCatalogue[] = {
    {2, 10002, kGeneralMessages, 0, false, "%-30s in %7.3lf seconds."},
    {7, 10007, kGeneralMessages, 3, false,
     "Internal error. Error code: %s%d. Please report it to the support, "
     "with the model if you can."},
    {90, 10651, kSystemMessages, 3, false, "Cannot create file: %s."},
    {403, 17051, kCompileMessages, 2, false,
     "Found unresolvable dependencies between the following %s : %s. Modify "
     "your modeling."},
    {408, 17056, kCompileMessages, 2, false,
     "C keyword %s used as identifier."},
    {409, 17057, kCompileMessages, 2, false,
     "Base type name %s used as identifier."},
    {410, 17058, kCompileMessages, 2, false,
     "User data type name %s used as identifier."},
    {503, 17260, kVariableMessages, 1, true, "A template name is empty."},
    {1202, 30303, kNamingMessages, 1, true,
     "The %s name macro in the %s name template is not supported here. It is "
     "ignored."},
    {1203, 30304, kNamingMessages, 1, true,
     "The %s name macro in the %s name template is unknown. It is ignored."},
    {1204, 30305, kNamingMessages, 2, true,
     "The $Task name macro is used in the task name template %s. This is not "
     "allowed."},
    {1205, 30306, kNamingMessages, 2, true,
     "A time/period/offset name macro is used in a noncyclic task. Name "
     "template: %s"},
    {1206, 30307, kNamingMessages, 1, true,
     "A time name macro '%s' with the time base %s is used. The period time "
     "%f or offset %f cannot be represented precisely with this time base."},
    {1207, 30308, kNamingMessages, 1, true,
     "The %s %s cannot be represented precisely with the $(Time) name macro."},
    {1209, 30310, kNamingMessages, 1, true,
     "The $(Component) name macro could not substitute"},
    {1210, 30311, kNamingMessages, 2, true,
     "The variable was referenced first through the RelatedVariables property "
     "%s of software component %s and second by the RelatedVariables property "
     "%s of software component %s."},
    {1272, 99000, kInternalMessages, 4, true, "%s."},
    {1273, 99001, kInternalMessages, 5, true, "%s."},
    {1274, 99002, kInternalMessages, 6, true, "%s."},
    {1275, 99003, kInternalMessages, 7, true, "%s."},
    {1292, 99023, kInternalMessages, 5, false, "INTERNAL: %s"},
};

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
