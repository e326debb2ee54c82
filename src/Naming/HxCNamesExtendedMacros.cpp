// Extended macros "$(Name)", and the software component of a variable.

#include <cstring>
#include <iterator>

#include "Control/ERR_Messages.h"
#include "Naming/HxCNames.h"
#include "SourceRef/HxCDdSrcRef.h"
#include "platform/datadictionary/HX_DataDictionary.h"
#include "platform/datadictionary/kyddapi.h"

namespace {

// Every extended macro; the names up to kFirstExpanded are known, but get their
// values before or after the expansion. One name stands twice.
constexpr const char* kExtendedNames[] = {"Task",
                                          "ISR",
                                          "Msg",
                                          "Ctr",
                                          "Event",
                                          "MsgVar",
                                          "PObj",
                                          "Time1us",
                                          "Time10us",
                                          "Time100us",
                                          "Time1ms",
                                          "Time10ms",
                                          "Time100ms",
                                          "Time1s",
                                          "Time1m",
                                          "Time1h",
                                          "Time1d",
                                          "Time",
                                          "Period1us",
                                          "Period10us",
                                          "Period100us",
                                          "Period1ms",
                                          "Period10ms",
                                          "Period100ms",
                                          "Period1s",
                                          "Period1m",
                                          "Period1h",
                                          "Period1d",
                                          "Period",
                                          "Offset1us",
                                          "Offset10us",
                                          "Offset100us",
                                          "Offset1ms",
                                          "Offset10ms",
                                          "Offset100ms",
                                          "Offset1s",
                                          "Offset1m",
                                          "Offset1h",
                                          "Offset1d",
                                          "Offset",
                                          "Section",
                                          "Module",
                                          "FunctionName",
                                          "DataVariantName",
                                          "PageNumber",
                                          "DataVariantName",
                                          "VariantItemName",
                                          "Type",
                                          "BaseType",
                                          "Component"};
constexpr int kUnknown = -1;
constexpr int kType = 47;
constexpr int kBaseType = 48;
constexpr int kComponent = 49;
constexpr int kFirstExpanded = kType;
static_assert(std::size(kExtendedNames) == kComponent + 1);

constexpr char kVariables[] = "//DD0/Pool/Variables/";
constexpr char kPool[] = "//DD0/Pool/";
constexpr char kSoftwareComponents[] = "/Pool/Autosar/SoftwareComponents";
constexpr unsigned short kSoftwareComponentKind = 145;
constexpr unsigned long kUnconnected = ~0UL;

// The last entry that equals \p name.
int extendedIndex(const KyCXString& name) {
  for (int i = kComponent; i >= 0; --i)
    if (name == kExtendedNames[i]) return i;
  return kUnknown;
}

// A text of the data dictionary interface, returned to it at the end.
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

// The component that a variable was found in first.
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

// Looks for \p variable in one component: the first component of all becomes
// its owner, every further reference is reported.
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

int HxCNames::evaluateExtendedNameMacro(
    KyCXString& result, unsigned int retainedMacros,
    unsigned int provisionalMacros, const KyCXString& form, int pos,
    HxCCIdentifier& id, HX_DataType* type, const HxCSrcRef*,
    const HxCSrcRef* reportRef, bool suppressMessages) {
  constexpr int kFrame = 3;  // '$' and both parentheses
  const int close = form.find(')', pos);
  if (close < 0) {
    result.appendSub(form, pos, form.length() - 1);
    return form.length();
  }
  const KyCXString name = form.sub(pos + 2, close - 1);
  const int index = extendedIndex(name);
  if (index < kFirstExpanded) {
    if (!suppressMessages) {
      const KyCXString macro = "$" + name;
      const auto report = index == kUnknown ? &ERR_Msg1203 : &ERR_Msg1202;
      report(reportRef, macro.cstring(), id.getRawName(kActive).cstring());
    }
    result += "__";
    result += name;
    result += "_";
  } else if (index == kType) {
    evaluateLongTypeMacro(result, retainedMacros, provisionalMacros, type);
  } else if (index == kBaseType) {
    evaluateBaseTypeMacro(result, retainedMacros, provisionalMacros, type);
  } else {
    evaluateComponentMacro(result, retainedMacros, provisionalMacros, id);
  }
  return name.length() + kFrame;
}

// Neither bit set has a bit for this macro.
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
  kyddapi::KYSDDHandleNode* components =
      pool.GetChildObjects(kSoftwareComponentKind, count, error);
  Owner owner;
  for (const auto* node = components; node != nullptr; node = node->next)
    searchComponent(node->handle, variable, variableRef, owner);
  DDAPIHeapFree(components);
  if (owner.found)
    result += owner.component;
  else
    ERR_Msg1209(variableRef);
}
