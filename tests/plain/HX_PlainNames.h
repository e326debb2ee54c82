// HxCNames in the plain form: same operations, same names, one step after the
// other, without tables of macros. Types, symbols and references are indices
// into the model.

#ifndef PLAIN_HX_PLAINNAMES_H
#define PLAIN_HX_PLAINNAMES_H

#include <map>

#include "plain/HX_PlainIdentifier.h"

namespace plain {

/// Reported messages, one text per message; see shownMessage().
using Messages = std::vector<std::string>;

/// "row/severity text", and the reference with its text.
std::string shownMessage(int row, int severity, const std::string& text,
                         int ref, const std::string& source);

class Names {
 public:
  enum tagMacroKindEnum { eExact, eAnyCase, eCaseSelectsValue };
  enum tagHxEDictEntryType { eKeyword, eBaseTypeName, eUserTypeName };
  using Id = Identifier;
  using Bits = unsigned int;

  Names(const Model& model, Messages& messages)
      : m_Model(model), m_Messages(messages) {}

  bool createNameFromForm(Id& id, int type, Bits retained, Bits provisional,
                          bool suppressMessages);
  bool substAllDollarZByValue(Id& id, const Text& macro, const Id& value,
                              tagMacroKindEnum kind);
  bool handleFileNameMacro(Id& id, bool useModelContext);
  void handleSymbolNameMacro(Id& id, int symbol);

  void boot();
  void addToKeywordDict(const Text& word, tagHxEDictEntryType type);
  bool isStringValidCVariableName(const Text& name);
  bool isFileNameValid(const Text& name);
  bool isFileNameValid(const Id& id);
  void appendSuffix(Text& name, int index);

  void replaceMultirateTimeName(Id& id, double period, double offset,
                                bool cyclic);
  void replaceMultirateTaskISRName(Id& id, const Id& task, const Id& isr,
                                   bool isTaskName);
  void replaceMultirateObjName(Id& id, const Id& v) { made(id, u"(PObj)", v); }
  void replaceMultirateEventName(Id& id, const Id& v) {
    made(id, u"(Event)", v);
  }
  void replaceMultirateISRName(Id& id, const Id& v) { made(id, u"(ISR)", v); }
  void replaceMultirateMsgName(Id& id, const Id& v) { made(id, u"(Msg)", v); }
  void replaceMultirateCtrName(Id& id, const Id& v) { made(id, u"(Ctr)", v); }
  void replaceMultirateMsgVarName(Id& id, const Text& text);

 private:
  struct Context {
    int srcRef = kNone, reportRef = kNone;
    int block = kNone, object = kNone, chartState = kNone, ivBlock = kNone;
    Text systemId, ddName;
    bool isChangeable = false;
  };

  void report(int row, int severity, int ref, const std::string& text);
  void assertion() { m_Messages.push_back("7"); }
  const Ref* refOf(int ref, Ref::Kind kind) const;

  void createSingleNameFromForm(Id& id, int type, Bits retained,
                                Bits provisional, bool suppressMessages);
  Context contextOf(const Id& id);
  Text getRootDollarI();
  std::size_t findDollarELength(const Text& text, std::size_t start);

  // The bit rule; true if the macro stays as text.
  bool stays(Text& result, Bits retained, Bits provisional, Bits bit,
             const Text& macro);
  void evaluateLabelMacro(Text& result, const Text& label, int block);
  void evaluateBlockNameMacro(Text& result, int block, int ivBlock);
  void evaluateSystemNumberMacro(Text& result, Context& context);
  void evaluateSFObjectIDMacro(Text& result, Context& context);
  void evaluateSFObjectNameMacro(Text& result, int object);
  void evaluateDollarD(Text& result, Bits retained, Bits provisional,
                       const Id& id, Context& context);
  void evaluateTypeNameMacro(Text& result, int type);
  void evaluateLongTypeMacro(Text& result, int type);
  void evaluateBaseTypeMacro(Text& result, int type);
  std::size_t evaluateExtendedNameMacro(Text& result, Bits retained,
                                        Bits provisional, const Text& form,
                                        std::size_t pos, const Id& id, int type,
                                        int reportRef, bool suppressMessages);
  void evaluateComponentMacro(Text& result, const Id& id);
  const Type& scalar(int type) const;

  bool substAllDollarZByValue(Id& id, const Text& macro, const Id& value,
                              tagMacroKindEnum kind, Id::Tag type);
  bool replaced(Id& id, const Text& macro, const Text& text) {
    return substAllDollarZByValue(id, macro, Id(text), eExact);
  }
  bool made(Id& id, const Text& macro, Id value) {
    value.makeCIdentifier();
    return substAllDollarZByValue(id, macro, value, eExact);
  }
  void replaceBaseTimeMacros(Id& id, double period, double offset);
  void replaceGenericTimeMacro(Id& id, double period, double offset);
  bool findGenericTimeMacro(double value, Text& text);
  void replaceAcyclicMultirateTimeName(Id& id);
  int multirateRef(const Id& id) const {
    return id.getSourceRef() != kNone ? id.getSourceRef() : id.getDdSourceRef();
  }

  const Model& m_Model;
  Messages& m_Messages;
  bool m_NameComplete = true;
  std::map<Text, int> m_Keywords;
};

}  // namespace plain

#endif  // PLAIN_HX_PLAINNAMES_H
