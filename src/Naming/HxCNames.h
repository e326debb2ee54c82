// Expands name templates into C names.
//
// A template is literal text with macros: '$' and a letter, or an extended
// macro "$(Name)". "$$" writes one '$'.
//
//   | macro | value                          | macro | value                 |
//   | $B    | block name                     | $L    | signal label or block |
//   | $S    | S, subsystem id and number     | $I    | subsystem id          |
//   | $M    | model name                     | $N    | subsystem name        |
//   | $O    | Stateflow object name          | $H    | states around         |
//   | $C    | C, subsystem id, object number | $D    | data dictionary name  |
//   | $T    | short name of the base type    | $X    | text of the name      |
//   | $R    | nothing; the name may change   | $(..) | Type, BaseType,       |
//   |       |                                |       | Component             |
//
// HX_MacroTable.h lists all macros with stage, placeholder and example.
//
//   HxCCIdentifier id("$S_$B");
//   id.setSourceRef(block.getSrcRef());
//   HxCNames names;
//   if (!names.createNameFromForm(id, nullptr, 0, 0, false)) ...  // not final
//
// Values of $L, $B, $O, $(Type) and $(BaseType) become C identifiers; all other
// values and the whole name stay as written. The caller applies
// makeCIdentifier() and adaptSize() as needed, asks
// isStringValidCVariableName(), and makes the name distinct.
//
// Without the object a placeholder is written: "_B" for $B, "__Type_" for
// $(Type). Exceptions: $L and $(Component) then write nothing, $I writes the
// subsystem id of the root, $S writes "S", the id of the root and "0" while the
// root has an id.

#ifndef NAMING_HXCNAMES_H
#define NAMING_HXCNAMES_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "Naming/HxCCIdentifier.h"
#include "platform/containers/ab_tree.h"
#include "platform/containers/dictionary.h"
#include "platform/strings/KyCXString.h"

struct HX_Macro;
class HX_BdBlock;
class HX_Block;
class HX_DataType;
class HxCSrcRef;
class HxCSymbol;
class SC_Model;

/// Light object: the only datum tells whether the last name was complete. The
/// keyword dictionary belongs to the process.
///
/// A macro bit set has one bit per macro, the eMacro... constants. A macro with
/// a bit in `retainedMacros` stays in the name as text, for a later call to
/// expand. A macro with a bit in `provisionalMacros` is expanded, but the name
/// is not final. Both make the name incomplete; with both bits the macro stays
/// as text. Exception: a provisional $D always becomes "_D".
///
/// MEMORY: an operation that runs out of memory returns false and leaves
/// arguments and dictionary as before the call. Of several macros (symbol
/// macros, multirate names) some may then be replaced, each macro in full or
/// not at all; the cook level stays, and a further call replaces the rest.
/// ERRORS: the error code of all internal assertions is "HxCNames".
class HX_UTILS_API HxCNames : public HX_Allocated {
 public:
  /// Bits of a macro bit set.
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

  /// Letter case of a macro in substAllDollarZByValue(); any other value counts
  /// as eMacroKindExact.
  enum tagMacroKindEnum : int {
    eMacroKindExact = 0,    ///< as written
    eMacroKindAnyCase = 1,  ///< in any mix of upper and lower case
    /// all in lower case: by the value; all in upper case: by the value in
    /// upper case
    eMacroKindCaseSelectsValue = 2
  };

  /// Kind of a word in the keyword dictionary.
  enum tagHxEDictEntryType : int {
    eDictCKeyword = 0,      ///< message 408 when used as an identifier
    eDictBaseTypeName = 1,  ///< message 409
    eDictUserTypeName = 2   ///< message 410
  };

  /// Answer of checkCVariableName().
  enum HxEVariableNameTag : int {
    eVariableNameValid = 0,
    eVariableNameEmpty = 1,
    eVariableNameCKeyword = 2,      ///< word of kind eDictCKeyword
    eVariableNameBaseType = 3,      ///< word of kind eDictBaseTypeName
    eVariableNameUserType = 4,      ///< word of kind eDictUserTypeName
    eVariableNameOtherWord = 5,     ///< word of another kind
    eVariableNameNoCIdentifier = 6  ///< no word, and no C identifier
  };

  /// Base time unit of the operating system.
  enum tagHxEOsekTimeBase : int { eOsekTimeBaseUs = 1, eOsekTimeBaseMs = 4 };

  HxCNames();
  HxCNames(const HxCNames& other);
  HxCNames& operator=(const HxCNames& other);
  virtual ~HxCNames();

  // --- Templates ---

  /// Expands both names of \p id and sets cook level 2. An identifier at
  /// level 2 stays as is; an identifier at level 3 is expanded again.
  ///
  /// Block, subsystem, Stateflow object and data dictionary object come from
  /// the references of the identifier:
  /// - without a source reference the reference of the intermediate-view block
  ///   counts;
  /// - a block named through the parent stands for the parent;
  /// - a chart block stands for block and chart object at once;
  /// - the subsystem id is the id of chart or block, and the id of the root for
  ///   an object without chart and block.
  ///
  /// $R and $S mark the name changeable, $C only with an object; the same holds
  /// where $D falls back to $S or $C. A mark set before the call stays.
  ///
  /// An actual template equal to the formal template, with or without "$R" at
  /// one end, is not expanded again: the actual name is a copy of the formal
  /// name, changeable with "$R" or a changeable formal name. A template without
  /// ':' is such a case. The flags "$L used", "$E used" and "$N used" of the
  /// copy are the answers of the getters of the formal name after the
  /// expansion, but at the cook level before the expansion.
  ///
  /// Messages go to the source reference of \p id, else to the reference of the
  /// intermediate-view block. \p suppressMessages leaves them out:
  /// - 503 (warning) for an empty template, replaced by "$C_$O" for a Stateflow
  ///   object and "$S_$B" else; without any reference an internal assertion
  ///   instead, in any case;
  /// - 1202 (warning) for a macro of another stage: $P, $V, $v, $F, $f, $E and
  ///   most extended macros;
  /// - 1203 (warning) for an unknown macro, also a '$' at the end.
  ///
  /// Macros with a message stay in the name, the argument of "$E(a-b)" as a C
  /// identifier ("$E_a_b_"); an extended macro "$(Name)" becomes "__Name_".
  /// From a "$(" without ')' on, the text is copied without a message.
  ///
  /// $(Component) is the first software component with a reference to the
  /// variable, and nothing for an object that is no variable. Messages go to
  /// the data dictionary reference and are never left out: 1209 (warning)
  /// without reference or component, 1210 (error) for each reference of a
  /// further component.
  /// \param type  type of $T, $(Type) and $(BaseType); may be null, else
  ///   HxCGlobal must have a data type server. A type of no known kind raises
  ///   an internal assertion and writes nothing.
  /// RETURNS: false if a macro was retained or provisional, or memory ran out.
  bool createNameFromForm(HxCCIdentifier& id, HX_DataType* type,
                          unsigned int retainedMacros,
                          unsigned int provisionalMacros,
                          bool suppressMessages);

  /// Replaces every macro "$" + \p macro in both cooked names of \p id by the
  /// cooked name of \p value of the same type. \p value may be \p id.
  ///
  /// The text of extended macros and the argument of "$E(...)" are never
  /// searched, but \p macro may be a whole extended macro: "(Task)". The
  /// argument of a replaced $E becomes plain text. "$$" is copied. An empty
  /// \p macro matches every '$'.
  ///
  /// With or without a replacement \p id takes over the references of \p value
  /// that are not null, and for the active name each flag that the getters of
  /// \p value answer with true for the active name. The macro E or e sets
  /// cook level 1, even from a higher level; a \p value at level 1 raises \p id
  /// from level 0 to 1. A replaced L, E or N in either case sets the "used"
  /// flag of the name. RETURNS: true if anything was replaced.
  bool substAllDollarZByValue(HxCCIdentifier& id, const KyCXString& macro,
                              const HxCCIdentifier& value,
                              tagMacroKindEnum kind);

  /// Expands the template of a file name: $B, $S, $I, $M, $N and $R. All other
  /// macros with a bit stay as text, macros without a bit are treated as in
  /// every template. Without a source reference $B, $S and $I stay as well,
  /// unless \p useModelContext; an intermediate-view block is no source
  /// reference.
  /// RETURNS: see createNameFromForm().
  bool handleFileNameMacro(HxCCIdentifier& id, bool useModelContext);

  /// Substitutes the symbol macros and sets cook level 3: $x by the text of the
  /// symbol, $f for a function or $v for any other symbol by the name ($F and
  /// $V in upper case), $t by the short name of the type (empty without a
  /// type). $X and $T count as $x and $t. A value is the template of an
  /// identifier: in the actual name "$R" follows the value, and a ':' in the
  /// value separates formal and actual value.
  void handleSymbolNameMacro(HxCCIdentifier& id, HxCSymbol* symbol);

  // --- Keywords and validity ---

  /// Creates the keyword dictionary with the 32 keywords of C90, in place of
  /// an older dictionary. Without memory nothing changes.
  static void boot();
  /// Destroys the keyword dictionary; without a dictionary does nothing.
  static void shutdown();

  /// Enters \p word. An older entry of the word takes the new kind. Words are
  /// equal where leda::compare says so. Without a dictionary an internal
  /// assertion fails and nothing is entered.
  void addToKeywordDict(const KyCXString& word, tagHxEDictEntryType type);

  /// RETURNS: the first reason in the order of the enumeration why \p name may
  /// not be used as a C variable. Reports and asserts nothing; without a
  /// dictionary no text is a word.
  static HxEVariableNameTag checkCVariableName(const KyCXString& name);
  /// RETURNS: true if checkCVariableName() finds \p name valid. A word of the
  /// dictionary is reported with message 408, 409 or 410 (error). Without a
  /// dictionary an internal assertion fails for a \p name that is not empty.
  bool isStringValidCVariableName(const KyCXString& name);

  /// RETURNS: true if \p name, a file name without extension, is not empty and
  /// holds only letters, digits, '_' and '-'. A leading digit, a keyword or the
  /// length do not matter.
  bool isFileNameValid(KyCXString& name);
  /// The same for the cooked active name of \p identifier.
  bool isFileNameValid(HxCCIdentifier& identifier);

  /// Appends '_' and the letter code of \p index: a, b, ... z, aa, ba, ... za,
  /// ab, ..., the least significant letter first. A negative \p index counts
  /// as 0. While the option that limits names is on, \p name is cut first: the
  /// result has at most HxCSymbol::sm_MaxNameLength characters.
  void appendSuffix(KyCXString& name, int index);

  // --- Multirate names ---
  //
  // All operations below replace macros in the cooked names of \p id by
  // substAllDollarZByValue(), at any cook level, and take over references and
  // flags of the identifiers given. An identifier given may be \p id. A text is
  // the template of an identifier: in the actual name "$R" follows the text,
  // and a ':' in the text separates formal and actual value. Messages go to the
  // source reference of \p id, else to the data dictionary reference.

  /// Replaces the time macros by \p period and \p offset in seconds. The period
  /// is not negative; a negative offset counts by amount.
  /// - "$(Time1ms)", "$(Period10us)", "$(Offset1s)"...: count of fixed units;
  /// - "$(Time)", "$(Period)", "$(Offset)": count of the largest exact unit up
  ///   to the value, with the unit ("10ms");
  /// - a time is the period and, unless the offset is 0, '_' and the offset.
  ///
  /// A value that is no multiple of the fixed unit is rounded and reported with
  /// message 1206 (warning); a value without a whole number of microseconds
  /// with 1207 (warning). Both are reported only where the macro occurs.
  /// FPS_IsIntegerValue decides what a multiple is: from 2^25 units on every
  /// value. Microseconds are whole to 2^-26 of the value, and to 2^-26 s below
  /// 1 s: $(Time) of 1.01 us is "1us" without a message. A count beyond 32 bits
  /// is saturated without a message of its own, the count of a NaN to the
  /// largest number; NaN and the infinities are reported.
  ///
  /// If not \p cyclic, every time macro becomes "ACYCLIC", with one message
  /// 1205 (error) for all macros.
  void replaceMultirateTimeName(HxCCIdentifier& id, double period,
                                double offset, bool cyclic);

  /// Replaces $(Task) by \p task, or by \p isr if the active cooked name of
  /// \p task is empty, and $(ISR) by \p isr. Values become C identifiers. In
  /// the name of a task (\p isTaskName) $(Task) becomes "__Task_" with message
  /// 1204 (error).
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

  /// Replaces $(MsgVar) by the text behind the last '#' of \p text without the
  /// last character, or by "1" without a '#'. The value is not made a C
  /// identifier.
  void replaceMultirateMsgVarName(HxCCIdentifier& id, const KyCXString& text);

 private:
  friend class HxCNamesTestAccess;

  class Restore;
  struct Scan;
  struct MacroRow;

  static constexpr HxCCIdentifier::HxENameTypeTag kActive =
      HxCCIdentifier::eActiveName;

  // Engine.
  void createBothNamesFromForm(HxCCIdentifier& id, HX_DataType* type,
                               unsigned int retainedMacros,
                               unsigned int provisionalMacros,
                               bool suppressMessages);
  void createSingleNameFromForm(HxCCIdentifier& id, HX_DataType* type,
                                unsigned int retainedMacros,
                                unsigned int provisionalMacros,
                                bool suppressMessages);
  KyCXString expandActiveName(HxCCIdentifier& id, HX_DataType* type,
                              unsigned int retainedMacros,
                              unsigned int provisionalMacros,
                              bool suppressMessages);
  void deriveContext(Scan& scan);
  static void enterBlock(Scan& scan);
  static void enterStateflowObject(Scan& scan);
  static KyCXString standInForm(const Scan& scan);
  void scanTemplate(Scan& scan);
  static const MacroRow* findMacro(unsigned short letter);
  static int expandDollar(HxCNames& names, Scan& scan);
  static int expandDollarD(HxCNames& names, Scan& scan);
  void keepForeignMacro(Scan& scan, unsigned short letter);
  static void reportForeignMacro(Scan& scan, const KyCXString& macro);
  int findDollarELength(const KyCXString& text, int start);
  void getRootDollarI(KyCXString& systemId);

  // Substitution. replaceAll() throws std::bad_alloc and then leaves the
  // identifier as before.
  bool replaceAll(HxCCIdentifier& id, const KyCXString& macro,
                  const HxCCIdentifier& value, tagMacroKindEnum kind);
  bool substAllDollarZByValue(HxCCIdentifier& id, const KyCXString& macro,
                              const HxCCIdentifier& value,
                              tagMacroKindEnum kind,
                              HxCCIdentifier::HxENameTypeTag type);
  bool substitutedText(const KyCXString& source, const KyCXString& macro,
                       const KyCXString& replacement, tagMacroKindEnum kind,
                       KyCXString& result);
  static void inherit(HxCCIdentifier& id, const KyCXString& macro,
                      const HxCCIdentifier& value);
  static void storeSubstituted(HxCCIdentifier& id, const KyCXString& macro,
                               KyCXString&& text,
                               HxCCIdentifier::HxENameTypeTag type);
  int endOfForeignMacro(const KyCXString& text, int dollar);

  // Evaluators append the value of a macro, the macro as text if retained, or a
  // placeholder, and return the number of template characters consumed.
  bool isRetained(KyCXString& result, unsigned int retainedMacros,
                  unsigned int provisionalMacros, const HX_Macro& macro);
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
  KyCXString getTypeNameInCode(HX_DataType* type);
  KyCXString baseTypeName(HX_DataType* scalar);
  int evaluateExtendedNameMacro(KyCXString& result, unsigned int retainedMacros,
                                unsigned int provisionalMacros,
                                KyCXString& form, int pos, HxCCIdentifier& id,
                                HX_DataType* type, const HxCSrcRef* srcRef,
                                const HxCSrcRef* reportRef,
                                bool suppressMessages);
  void evaluateComponentMacro(KyCXString& result, unsigned int retainedMacros,
                              unsigned int provisionalMacros,
                              HxCCIdentifier& id);

  // Multirate names.
  void replaceBaseTimeMacros(HxCCIdentifier& id, double period, double offset);
  void replaceGenericTimeMacro(HxCCIdentifier& id, double period,
                               double offset);
  bool findGenericTimeMacro(double value, KyCXString& text);
  void replaceAcyclicMultirateTimeName(HxCCIdentifier& id);
  bool replaceMacro(HxCCIdentifier& id, const char* macro,
                    const KyCXString& text);
  bool replaceByTemplate(HxCCIdentifier& id, const char* macro,
                         const KyCXString& text);
  void replaceByIdentifier(HxCCIdentifier& id, const HX_Macro& macro,
                           const HxCCIdentifier& value);
  // Chooses the unit for \p value; 1000000 and above changes nothing.
  void determineOsekBaseTime(double value, tagHxEOsekTimeBase& base,
                             KyCXString& unit);

  static leda::dictionary<KyCXString, tagHxEDictEntryType, leda::ab_tree>*
      s_pKeywordDict;

  bool m_NameComplete = true;
};

#endif  // NAMING_HXCNAMES_H
