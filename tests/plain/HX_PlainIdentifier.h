// HxCCIdentifier in the plain form: same operations, same names.

#ifndef PLAIN_HX_PLAINIDENTIFIER_H
#define PLAIN_HX_PLAINIDENTIFIER_H

#include "plain/HX_PlainModel.h"

namespace plain {

class Identifier {
 public:
  enum HxENameTypeTag { eActiveName, eActualName, eFormalName };
  enum HxECookLevelTag { eRaw, eDollarE, eFull, eSymbol };
  using Tag = HxENameTypeTag;

  Identifier() = default;
  Identifier(const Text& name) { setName(name); }

  bool setName(const Text& given) {
    const Text name = given;  // may be a name of this identifier
    *this = Identifier();
    const std::vector<Text> parts = split(name, ':');
    if (parts.size() == 1) {
      m_Actual.raw = m_Actual.cooked = name + u"$R";
      m_Formal.raw = m_Formal.cooked = name;
      return true;
    }
    m_Actual.raw = m_Actual.cooked = parts[1];
    m_Formal.raw = m_Formal.cooked = parts[0];
    return parts.size() == 2;
  }

  const Text& getRawName(Tag type) const { return name(type).raw; }
  const Text& getCookedName(Tag type) const { return name(type).cooked; }
  void setCookedName(const Text& text, Tag type) { name(type).cooked = text; }

  void addPrefix(const Text& prefix) {
    for (Text* text : texts()) *text = prefix + *text;
  }
  void addPostfix(const Text& postfix) {
    for (Text* text : texts()) *text += postfix;
  }
  Identifier& operator+=(const Text& given) {
    addPostfix(Text(given));  // may be a name of this identifier
    return *this;
  }
  void makeCIdentifier() {
    m_Actual.cooked = cIdentifier(m_Actual.cooked);
    m_Formal.cooked = cIdentifier(m_Formal.cooked);
  }
  void adaptSize(bool limitsNames) {
    if (!getIdentifierChangeable(eActiveName) || !limitsNames) return;
    m_Actual.cooked = shortened(m_Actual.cooked, 31);
    m_Formal.cooked = shortened(m_Formal.cooked, 31);
  }

  bool isFormalNameActive() const { return m_IsFormalActive; }
  void activateFormalName() { m_IsFormalActive = true; }
  void activateActualName() { m_IsFormalActive = false; }
  HxECookLevelTag getCookLevel() const { return m_Level; }
  void setCookLevel(HxECookLevelTag level) { m_Level = level; }

  void setIdentifierChangeable(bool v, Tag t) { name(t).isChangeable = v; }
  bool getIdentifierChangeable(Tag t) const { return name(t).isChangeable; }
  void setDollarLUsed(bool v, Tag t) { name(t).usesL = v; }
  bool getDollarLUsed(Tag t) const { return uses(u"$L", name(t).usesL, t, 2); }
  void setDollarEUsed(bool v, Tag t) { name(t).usesE = v; }
  bool getDollarEUsed(Tag t) const { return uses(u"$E", name(t).usesE, t, 1); }
  void setDollarNUsed(bool v, Tag t) { name(t).usesN = v; }
  bool getDollarNUsed(Tag t) const { return uses(u"$N", name(t).usesN, t, 2); }

  const Text& getSignalLabel() const { return m_SignalLabel; }
  void setSignalLabel(const Text& label) { m_SignalLabel = label; }
  int getSourceRef() const { return m_SourceRef; }
  void setSourceRef(int ref) { m_SourceRef = ref; }
  int getDdSourceRef() const { return m_DdSourceRef; }
  void setDdSourceRef(int ref) { m_DdSourceRef = ref; }
  int getSourceIVBlock() const { return m_SourceIVBlock; }
  void setSourceIVBlock(int block) { m_SourceIVBlock = block; }
  void getDollarXValue(Text& value) const { value = m_DollarX; }
  void setDollarXValue(const Text& value) { m_DollarX = value; }

  friend bool operator==(const Identifier& a, const Identifier& b) {
    return a.getRawName(eActiveName) == b.getRawName(eActiveName);
  }

 private:
  struct Name {
    Text raw, cooked;
    bool isChangeable = false, usesL = false, usesE = false, usesN = false;
  };

  const Name& name(Tag type) const {
    if (type == eActiveName)
      type = m_IsFormalActive ? eFormalName : eActualName;
    return type == eFormalName ? m_Formal : m_Actual;
  }
  Name& name(Tag type) {
    return const_cast<Name&>(static_cast<const Identifier*>(this)->name(type));
  }
  bool uses(const Text& macro, bool stored, Tag type, int threshold) const {
    if (m_Level >= threshold) return stored;
    return name(type).cooked.find(macro) != Text::npos;
  }
  std::vector<Text*> texts() {
    return {&m_Actual.raw, &m_Formal.raw, &m_Actual.cooked, &m_Formal.cooked};
  }

  Name m_Actual, m_Formal;
  bool m_IsFormalActive = true;
  HxECookLevelTag m_Level = eRaw;
  Text m_SignalLabel;
  int m_SourceRef = kNone, m_DdSourceRef = kNone, m_SourceIVBlock = kNone;
  Text m_DollarX;
};

}  // namespace plain

#endif  // PLAIN_HX_PLAINIDENTIFIER_H
