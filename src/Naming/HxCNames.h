// Expands name templates into C names.
//
// A template is literal text with macros: '$' and a letter, or an extended
// macro "$(Name)". "$$" writes one '$'.
//
//   | macro | value                          | macro | value                 |
//   | $B    | block name                     | $L    | signal label or block |
//   | $S    | S, subsystem id and number     | $I    | subsystem id          |
//   | $M    | model name                     | $N    | subsystem name        |
//   | $O    | Stateflow object name          | $H    | its state hierarchy   |
//   | $C    | C, subsystem id, object number | $D    | data dictionary name  |
//   | $T    | short name of the base type    | $X    | the identifier's text |
//   | $R    | nothing; the name may change   | $(..) | Type, BaseType,       |
//   |       |                                |       | Component             |
//
//   HxCCIdentifier id("$S_$B");
//   id.setSourceRef(block.getSrcRef());
//   HxCNames names;
//   if (!names.createNameFromForm(id, nullptr, 0, 0, false)) ...  // not final
//
// The values of $L, $B, $O, $(Type) and $(BaseType) become C identifiers, all
// others are written as they are, and the whole name is not made one: the
// caller applies makeCIdentifier() and adaptSize() as it needs, asks
// isStringValidCVariableName(), and makes the name distinct.
//
// Where the object is missing, '_' and the letter stand for the value ("_B"),
// "__Type_" and "__BaseType_" for the extended ones; $L, $I and $(Component)
// then write nothing, and the number of $S is 0 as long as there is an id.

#ifndef NAMING_HXCNAMES_H
#define NAMING_HXCNAMES_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "Naming/HxCCIdentifier.h"
#include "platform/containers/ab_tree.h"
#include "platform/containers/dictionary.h"
#include "platform/strings/KyCXString.h"

class HX_BdBlock;
class HX_Block;
class HX_DataType;
class HxCSrcRef;
class HxCSymbol;
class SC_Model;

/// Light: its one datum tells whether the last name was complete. The keyword
/// dictionary belongs to the process.
///
/// A macro bit set has one bit per macro, the eMacro... constants. A macro
/// whose bit is in `retainedMacros` stays in the name as text, for a later call
/// to expand; one whose bit is in `provisionalMacros` is expanded, but the name
/// is not final. Either makes the name incomplete; with both bits the macro
/// stays as text. $D alone differs: provisional, it always becomes "_D".
class HX_UTILS_API HxCNames : public HX_Allocated {
 public:
  /// The bits of the macros in a macro bit set.
  enum HxEMacroBitTag : unsigned int {
    eMacroLabel = 0x1,             ///< $L
    eMacroBlockName = 0x2,         ///< $B
    eMacroSystemNumber = 0x4,      ///< $S
    eMacroSystemId = 0x8,          ///< $I
    eMacroModelName = 0x10,        ///< $M
    eMacroSubsystemName = 0x20,    ///< $N
    eMacroStateHierarchy = 0x40,   ///< $H
    eMacroSFObjectName = 0x80,     ///< $O
    eMacroSFObjectId = 0x100,      ///< $C
    eMacroDdObjectName = 0x200,    ///< $D
    eMacroTypeName = 0x400,        ///< $T
    eMacroXName = 0x800,           ///< $X
    eMacroChangeable = 0x1000,     ///< $R
    eMacroLongTypeName = 0x80000,  ///< $(Type) and $(BaseType)
  };

  /// How substAllDollarZByValue() matches a macro name; any other value counts
  /// as eMacroKindExact.
  enum tagMacroKindEnum : int {
    eMacroKindExact = 0,    ///< as written
    eMacroKindAnyCase = 1,  ///< in any mix of upper and lower case
    /// all in lower case: by the value; all in upper case: by the value in
    /// upper case
    eMacroKindCaseSelectsValue = 2
  };

  /// The kind of a word in the keyword dictionary.
  enum tagHxEDictEntryType : int {
    eDictCKeyword = 0,      ///< message 408 when used as an identifier
    eDictBaseTypeName = 1,  ///< message 409
    eDictUserTypeName = 2   ///< message 410
  };

  /// The base time unit of the operating system.
  enum tagHxEOsekTimeBase : int { eOsekTimeBaseUs = 1, eOsekTimeBaseMs = 4 };

  HxCNames() = default;
  HxCNames(const HxCNames&) = default;
  HxCNames& operator=(const HxCNames&) = default;
  virtual ~HxCNames();

  // --- Templates ---

  /// Expands both names of \p id and sets its cook level to 2; an identifier
  /// that is at level 2 already stays as it is, but one at level 3 is expanded
  /// again.
  ///
  /// Block, subsystem, Stateflow object and data dictionary object are those of
  /// the identifier's references; the reference of its intermediate-view block
  /// stands in for a missing source reference. A block named through its parent
  /// counts as the parent, a chart block as the object of its chart, too.
  /// Without block and object the subsystem id is that of the root.
  ///
  /// $R, $S, and $C of an object mark the name changeable, also where $D falls
  /// back to them. An actual template that is the formal one, with or without
  /// "$R" at one end, is not expanded for itself: the actual name is a copy of
  /// the formal one, changeable if that is or if there was an "$R". A template
  /// without ':' is such a case. The copy's "$L used" and its siblings are what
  /// the getters of the formal name answer after the expansion, at the level
  /// before it: below the threshold whether the expanded text still holds the
  /// macro.
  ///
  /// Messages, attached to the source reference of \p id or else of its
  /// intermediate-view block, and left out with \p suppressMessages:
  /// - 503 (warning) for an empty template, which becomes "$C_$O" for a
  ///   Stateflow object and "$S_$B" else; without any reference an internal
  ///   assertion instead, in any case;
  /// - 1202 (warning) for a macro that is not expanded here: $P, $V, $v, $F,
  ///   $f, $E and most extended ones;
  /// - 1203 (warning) for an unknown macro, also a '$' at the end.
  /// The single-letter ones stay in the name, an argument as in "$E(a-b)" as a
  /// C identifier ("$E_a_b_"); of an extended macro "$(Name)" "__Name_" is
  /// left. From a "$(" without ')' on, the text is copied silently.
  ///
  /// $(Component) is the first software component that refers to the variable;
  /// nothing for an object that is no variable. Its messages are attached to
  /// the data dictionary reference and never left out: 1209 (warning) if there
  /// is no reference or no such component, 1210 (error) for each reference of a
  /// further component.
  /// \param type  what $T, $(Type) and $(BaseType) speak of; may be null, else
  ///   HxCGlobal must have a data type server. A type of no known kind raises
  ///   an internal assertion and writes nothing.
  /// \return false if a macro was retained or provisional
  bool createNameFromForm(HxCCIdentifier& id, HX_DataType* type,
                          unsigned int retainedMacros,
                          unsigned int provisionalMacros,
                          bool suppressMessages);

  /// Replaces every macro "$" + \p macro in both cooked names of \p id by the
  /// cooked name of \p value of the same type. Extended macros and the argument
  /// of "$E(...)" are never looked into, but \p macro may itself be an extended
  /// one with its parentheses, "(Task)"; the argument of an $E that is itself
  /// replaced becomes plain text. "$$" is copied. An empty \p macro matches
  /// every '$'. \p value may be \p id.
  ///
  /// Whether or not anything is replaced, \p id takes over the references of
  /// \p value that are not null, and for its active name each flag that the
  /// getters of \p value answer true for the active one; and the macro E or e
  /// sets \p id to cook level 1, even from a higher one, as does a \p value at
  /// level 1 if \p id is at level 0. A replaced L, E or N in either case sets
  /// the "used" flag of that name.
  /// \return whether anything was replaced
  bool substAllDollarZByValue(HxCCIdentifier& id, const KyCXString& macro,
                              const HxCCIdentifier& value,
                              tagMacroKindEnum kind);

  /// Expands the template of a file name: $B, $S, $I, $M, $N and $R; every
  /// other single-letter macro stays, $(Type) and $(BaseType) as well, and the
  /// other extended ones are treated as in every template. Without a source
  /// reference, and unless \p useModelContext, $B, $S and $I stay, too.
  /// \return see createNameFromForm()
  bool handleFileNameMacro(HxCCIdentifier& id, bool useModelContext);

  /// Substitutes $x (the symbol's text), $f for a function or $v for any other
  /// symbol (its name, $F and $V in upper case) and $t (the short name of its
  /// type, empty without one), and sets the cook level to 3. $X and $T count as
  /// $x and $t. Each value is put in as the template of an identifier: in the
  /// actual name it is followed by "$R", unless a ':' in it gives the two names
  /// apart.
  void handleSymbolNameMacro(HxCCIdentifier& id, HxCSymbol* symbol);

  // --- Keywords and validity ---

  /// Creates the keyword dictionary with the 32 keywords of C90, in place of
  /// one that is there.
  static void boot();
  /// Destroys the keyword dictionary, if there is one.
  static void shutdown();

  /// Enters \p word; a word already there becomes one of this kind. Without a
  /// dictionary an internal assertion fails and nothing is entered.
  void addToKeywordDict(const KyCXString& word, tagHxEDictEntryType type);

  /// Whether \p name may be used as a C variable: not empty, no word of the
  /// dictionary, a valid C identifier. A word of the dictionary is reported
  /// with message 408, 409 or 410 (error). Without a dictionary an internal
  /// assertion fails, and the answer is that of the C rules alone.
  bool isStringValidCVariableName(const KyCXString& name);

  /// Whether \p name, a file name without its extension, is not empty and holds
  /// only letters, digits, '_' and '-'. Nothing else counts: not a leading
  /// digit, not a keyword, not the length.
  bool isFileNameValid(KyCXString& name);
  /// The same for the cooked active name.
  bool isFileNameValid(HxCCIdentifier& identifier);

  /// Appends '_' and the letter code of \p index: a, b, ... z, aa, ba, ... za,
  /// ab, ..., the least significant letter first. A negative \p index counts
  /// as 0. With the option that limits names on, the text is cut before, so
  /// that the result has at most HxCSymbol::sm_MaxNameLength characters.
  void appendSuffix(KyCXString& name, int index);

  // --- Multirate names ---
  //
  // Each replaces macros in the cooked names of \p id with
  // substAllDollarZByValue(), whatever its cook level, and so takes over the
  // references and flags of the identifiers given, which may be \p id itself. A
  // text is put in as the template of an identifier: in the actual name it is
  // followed by "$R", unless a ':' in it gives the two names apart. Messages
  // are attached to the source reference of \p id or else to its data
  // dictionary reference.

  /// Replaces the time macros by \p period and \p offset (seconds; of a
  /// negative offset its amount, a period is not negative): "$(Time1ms)",
  /// "$(Period10us)", "$(Offset1s)"... in a fixed unit, "$(Time)", "$(Period)"
  /// and "$(Offset)" in the largest exact unit up to the value, with that unit
  /// ("10ms"). A time is the period and, unless the offset is 0, '_' and the
  /// offset.
  ///
  /// A value that is not a multiple of the fixed unit is rounded and reported
  /// with message 1206 (warning), one that is no whole number of microseconds
  /// with 1207 (warning), each only where the macro occurs. What is a multiple,
  /// also of the largest unit, FPS_IsIntegerValue tells: from 2^25 units on
  /// every value. Microseconds are whole to 2^-26 of the value, 2^-26 s below
  /// 1 s: $(Time) of 1.01 us is silently "1us". A count beyond the 32-bit range
  /// is saturated without a message of its own, that of a NaN is the largest
  /// one; NaN and the infinities are reported. If not \p cyclic, every time
  /// macro becomes "ACYCLIC", and one message 1205 (error) is reported if there
  /// was any.
  void replaceMultirateTimeName(HxCCIdentifier& id, double period,
                                double offset, bool cyclic);

  /// Replaces $(Task) by \p task, or by \p isr if \p task has an empty active
  /// cooked name, and $(ISR) by \p isr, both as C identifiers. In the name of a
  /// task itself (\p isTaskName) $(Task) becomes "__Task_" with message 1204
  /// (error).
  void replaceMultirateTaskISRName(HxCCIdentifier& id,
                                   const HxCCIdentifier& task,
                                   const HxCCIdentifier& isr, bool isTaskName);

  /// Replaces $(PObj), $(Event), $(ISR), $(Msg), $(Ctr) by the second argument
  /// as a C identifier.
  void replaceMultirateObjName(HxCCIdentifier& id, const HxCCIdentifier& obj);
  void replaceMultirateEventName(HxCCIdentifier& id,
                                 const HxCCIdentifier& event);
  void replaceMultirateISRName(HxCCIdentifier& id, const HxCCIdentifier& isr);
  void replaceMultirateMsgName(HxCCIdentifier& id, const HxCCIdentifier& msg);
  void replaceMultirateCtrName(HxCCIdentifier& id, const HxCCIdentifier& ctr);

  /// Replaces $(MsgVar) by what follows the last '#' of \p text, without its
  /// last character; by "1" if there is no '#'. The value is not made a C
  /// identifier.
  void replaceMultirateMsgVarName(HxCCIdentifier& id, const KyCXString& text);

 private:
  friend class HxCNamesTestAccess;

  struct Context;
  struct Scan;
  struct MacroRow;

  static constexpr HxCCIdentifier::HxENameTypeTag kActive =
      HxCCIdentifier::eActiveName;

  // Engine.
  void createSingleNameFromForm(HxCCIdentifier& id, HX_DataType* type,
                                unsigned int retainedMacros,
                                unsigned int provisionalMacros,
                                bool suppressMessages);
  void deriveContext(HxCCIdentifier& id, Context& context);
  static void enterBlock(Context& context);
  static void enterStateflowObject(Context& context);
  static KyCXString standInForm(const Context& context, bool suppressMessages);
  void scanTemplate(Scan& scan);
  static const MacroRow* findMacro(unsigned short letter);
  int expandDollarD(Scan& scan);
  static void keepForeignMacro(Scan& scan, unsigned short letter);
  bool substAllDollarZByValue(HxCCIdentifier& id, const KyCXString& macro,
                              const HxCCIdentifier& value,
                              tagMacroKindEnum kind,
                              HxCCIdentifier::HxENameTypeTag type);
  static int findDollarELength(const KyCXString& text, int start);
  static int endOfForeignMacro(const KyCXString& text, int dollar);
  void getRootDollarI(KyCXString& systemId);

  // Evaluators: each appends its macro's value, its text if it is retained, or
  // a placeholder, and returns the number of template characters it consumed.
  bool isRetained(KyCXString& result, unsigned int retainedMacros,
                  unsigned int provisionalMacros, unsigned int bit,
                  const char* macro);
  int evaluateLabelMacro(KyCXString& result, unsigned int retainedMacros,
                         unsigned int provisionalMacros,
                         const KyCXString& label, const HX_Block* block);
  int evaluateBlockNameMacro(KyCXString& result, unsigned int retainedMacros,
                             unsigned int provisionalMacros,
                             const HX_Block* block, HX_BdBlock* ivBlock);
  int evaluateSystemNumberMacro(KyCXString& result, unsigned int retainedMacros,
                                unsigned int provisionalMacros, HX_Block* block,
                                const KyCXString& systemId, bool& changeable);
  int evaluateSystemIDMacro(KyCXString& result, unsigned int retainedMacros,
                            unsigned int provisionalMacros,
                            const KyCXString& systemId);
  int evaluateModelNameMacro(KyCXString& result, unsigned int retainedMacros,
                             unsigned int provisionalMacros);
  int evaluateSubsystemNameMacro(KyCXString& result,
                                 unsigned int retainedMacros,
                                 unsigned int provisionalMacros);
  int evaluateStateHierarchyMacro(KyCXString& result,
                                  unsigned int retainedMacros,
                                  unsigned int provisionalMacros,
                                  const SC_Model* object);
  int evaluateSFObjectNameMacro(KyCXString& result, unsigned int retainedMacros,
                                unsigned int provisionalMacros,
                                const SC_Model* object);
  int evaluateSFObjectIDMacro(KyCXString& result, unsigned int retainedMacros,
                              unsigned int provisionalMacros,
                              const SC_Model* object,
                              const KyCXString& systemId, bool& changeable);
  int evaluateDdObjectNameMacro(KyCXString& result, unsigned int retainedMacros,
                                unsigned int provisionalMacros,
                                const KyCXString& ddName);
  int evaluateXNameMacro(KyCXString& result, unsigned int retainedMacros,
                         unsigned int provisionalMacros,
                         const KyCXString& xValue);
  int evaluateSFObjectRMacro(KyCXString& result, unsigned int retainedMacros,
                             unsigned int provisionalMacros, bool& changeable);
  int evaluateTypeNameMacro(KyCXString& result, unsigned int retainedMacros,
                            unsigned int provisionalMacros, HX_DataType* type);
  void evaluateLongTypeMacro(KyCXString& result, unsigned int retainedMacros,
                             unsigned int provisionalMacros, HX_DataType* type);
  void evaluateBaseTypeMacro(KyCXString& result, unsigned int retainedMacros,
                             unsigned int provisionalMacros, HX_DataType* type);
  static KyCXString getTypeNameInCode(HX_DataType* type);
  static KyCXString baseTypeName(HX_DataType* scalar);
  int evaluateExtendedNameMacro(KyCXString& result, unsigned int retainedMacros,
                                unsigned int provisionalMacros,
                                const KyCXString& form, int pos,
                                HxCCIdentifier& id, HX_DataType* type,
                                const HxCSrcRef* srcRef,
                                const HxCSrcRef* reportRef,
                                bool suppressMessages);
  void evaluateComponentMacro(KyCXString& result, unsigned int retainedMacros,
                              unsigned int provisionalMacros,
                              HxCCIdentifier& id);

  // Multirate names.
  void replaceBaseTimeMacros(HxCCIdentifier& id, double period, double offset);
  void replaceGenericTimeMacro(HxCCIdentifier& id, double period,
                               double offset);
  static bool findGenericTimeMacro(double value, KyCXString& text);
  void replaceAcyclicMultirateTimeName(HxCCIdentifier& id);
  bool replaceMacro(HxCCIdentifier& id, const char* macro,
                    const KyCXString& text);
  void replaceByIdentifier(HxCCIdentifier& id, const char* macro,
                           const HxCCIdentifier& value);
  // Chooses the unit for \p value; 1000000 and above changes nothing.
  static void determineOsekBaseTime(double value, tagHxEOsekTimeBase& base,
                                    KyCXString& unit);

  static leda::dictionary<KyCXString, tagHxEDictEntryType, leda::ab_tree>*
      s_pKeywordDict;

  bool m_NameComplete = true;
};

#endif  // NAMING_HXCNAMES_H
