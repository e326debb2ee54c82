// Extended macros "$(Name)", and the software component of a variable.

#include "Control/ERR_Messages.h"
#include "Control/HX_TextCalls.h"
#include "Naming/HX_MacroRows.h"
#include "Naming/HxCNames.h"
#include "SourceRef/HxCDdSrcRef.h"
#include "platform/datadictionary/HX_DataDictionary.h"
#include "platform/datadictionary/kyddapi.h"

namespace {

constexpr char kVariables[] = "//DD0/Pool/Variables/";
constexpr char kPool[] = "//DD0/Pool/";
constexpr char kSoftwareComponents[] = "/Pool/Autosar/SoftwareComponents";
constexpr unsigned short kSoftwareComponentKind = 145;
constexpr unsigned long kUnconnected = ~0UL;

// Text of the data dictionary interface, released at the end.
class DdText {
 public:
  DdText() = default;
  DdText(const DdText&) = delete;
  DdText& operator=(const DdText&) = delete;
  ~DdText() { DDAPIHeapFree(m_Text); }

  char*& receive() { return m_Text; }
  const char* get() const { return m_Text == nullptr ? "" : m_Text; }

 private:
  char* m_Text = nullptr;
};

// List of handles of the data dictionary interface, released at the end.
class DdHandles {
 public:
  explicit DdHandles(kyddapi::KYSDDHandleNode* first) : m_First(first) {}
  DdHandles(const DdHandles&) = delete;
  DdHandles& operator=(const DdHandles&) = delete;
  ~DdHandles() { DDAPIHeapFree(m_First); }

  const kyddapi::KYSDDHandleNode* first() const { return m_First; }

 private:
  kyddapi::KYSDDHandleNode* m_First;
};

// First component that refers to the variable.
struct Owner {
  bool found = false;
  KyCXString property;
  KyCXString component;
};

KyCXString componentName(const kyddapi::KYCDDObject& component) {
  DdText name;
  unsigned short length = 0;
  component.GetName(name.receive(), length);
  return name.get();
}

KyCXString propertyName(const kyddapi::KYCDDObject& list, long index) {
  DdText name;
  unsigned short length = 0;
  list.GetPropertyName(name.receive(), length, index);
  return name.get();
}

// Whether property \p index refers to the variable or a group around it.
bool refersTo(const kyddapi::KYCDDObject& list, long index,
              const KyCXString& variable) {
  DdText path;
  unsigned long length = 0;
  if (!list.ReadRefPathFromDDK(index, path.receive(), length, 0)) return false;
  return variable.startsWith(path.get());
}

// Looks for \p variable in one component. The first component found becomes
// the owner; references of further components are reported.
void searchComponent(unsigned long handle, const KyCXString& variable,
                     const HxCSrcRef* variableRef, Owner& owner) {
  kyddapi::KYCDDSoftwareComponent component(kUnconnected);
  component.ConnectToDDObject(handle);
  if (!HX_DataDictionary::isValidDdHandle(component.GetHandle())) return;
  unsigned short error = 0;
  const kyddapi::KYCDDObject list = component.GetRelatedVariables(error);
  const long count = list.GetNumOfProps();
  for (long index = 0; index < count; ++index) {
    if (!refersTo(list, index, variable)) continue;
    const KyCXString property = propertyName(list, index);
    const KyCXString name = componentName(component);
    if (!owner.found) {
      owner = {true, property, name};
      return;
    }
    ERR_Msg1210(variableRef, owner.property.cstring(),
                owner.component.cstring(), property.cstring(), name.cstring());
  }
}

}  // namespace

// A known name beyond the three that are expanded here waits for another stage.
int HxCNames::evaluateExtendedNameMacro(
    KyCXString& result, unsigned int retainedMacros,
    unsigned int provisionalMacros, KyCXString& form, int pos,
    HxCCIdentifier& id, HX_DataType* type, const HxCSrcRef*,
    const HxCSrcRef* reportRef, bool suppressMessages) {
  const int close = form.find(')', pos);
  if (close < 0) {
    HX_AppendSub(result, form, pos, form.length() - 1);
    return form.length();
  }
  const HX_Macro* macro = HX_FindMacro(form, pos);
  if (macro == &HX_MacroOf("$(Type)")) {
    evaluateLongTypeMacro(result, retainedMacros, provisionalMacros, type);
  } else if (macro == &HX_MacroOf("$(BaseType)")) {
    evaluateBaseTypeMacro(result, retainedMacros, provisionalMacros, type);
  } else if (macro == &HX_MacroOf("$(Component)")) {
    evaluateComponentMacro(result, retainedMacros, provisionalMacros, id);
  } else {
    const KyCXString name = form.sub(pos + 2, close - 1);
    const KyCXString shown = "$" + name;
    const char* raw = id.getRawName(kActive).cstring();
    if (!suppressMessages && macro != nullptr)
      ERR_Msg1202(reportRef, shown.cstring(), raw);
    else if (!suppressMessages)
      ERR_Msg1203(reportRef, shown.cstring(), raw);
    result += "__";
    result += name;
    result += "_";
  }
  return close + 1 - pos;
}

// No bit of the bit sets belongs to $(Component).
void HxCNames::evaluateComponentMacro(KyCXString& result, unsigned int,
                                      unsigned int, HxCCIdentifier& id) {
  const HxCSrcRef* reference = id.getDdSourceRef();
  if (reference == nullptr && id.getSourceRef() != nullptr)
    reference = id.getSourceRef()->isDd();
  const HxCDdSrcRef* variableRef =
      reference == nullptr ? nullptr : reference->isDd();
  if (variableRef == nullptr) {
    ERR_Msg1209(reference);
    return;
  }
  KyCXString variable;
  variableRef->getDdPath(variable);
  if (!variable.startsWith(kVariables)) return;
  variable.replace(kPool, "");

  kyddapi::KYCDDObject pool(kUnconnected);
  pool.ConnectToDDObject(kSoftwareComponents);
  if (!HX_DataDictionary::isValidDdHandle(pool.GetHandle())) {
    ERR_Msg1209(variableRef);
    return;
  }
  long count = 0;
  unsigned short error = 0;
  const DdHandles components(
      pool.GetChildObjects(kSoftwareComponentKind, count, error));
  Owner owner;
  for (const auto* node = components.first(); node != nullptr;
       node = node->next)
    searchComponent(node->handle, variable, variableRef, owner);
  if (owner.found)
    result += owner.component;
  else
    ERR_Msg1209(variableRef);
}
