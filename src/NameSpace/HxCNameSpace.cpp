#include "NameSpace/HxCNameSpace.h"

#include "Control/HX_SelfCheck.h"
#include "NameSpace/HxCXStringIdServer.h"
#include "platform/strings/KyCXString.h"

namespace {

constexpr char kNameSpaceErrorCode[] = "HxCNameSpace";

bool symbolOf(const HxCSmbScopeData* data, HxCSymbol*& symbol,
              const char* expression) {
  if (data == nullptr) return false;
  symbol = data->getSymbol();
  HX_DebugCheck(symbol != nullptr, expression);
  return true;
}

}  // namespace

int HxCNameSpace::sm_ObjectCount = 0;

HxCNameSpace::HxCNameSpace(HxCXStringIdServer* idServer)
    : m_pIdServer(idServer), m_DebugIndex(sm_ObjectCount++) {}

HxCNameSpace::Scope* HxCNameSpace::newEnv() {
  if (!HX_Assert(m_pScope == nullptr, kNameSpaceErrorCode)) return m_pScope;
  return newScope(nullptr);
}

HxCNameSpace::Scope* HxCNameSpace::newScope(Scope* parent) {
  if (m_pScope != nullptr) return m_pScope;
  Scope* const scope = new Scope(parent);
  if (scope == nullptr) return nullptr;
  if (parent != nullptr && !parent->addChild(scope)) {
    delete scope;
    return nullptr;
  }
  return m_pScope = scope;
}

void HxCNameSpace::createIdn(const KyCXString& s, int& key) { keyOf(s, key); }

bool HxCNameSpace::defineIdn(int key) {
  return hasScope() && m_pScope->defineKey(key, nullptr);
}

bool HxCNameSpace::defineIdn(int key, HxCSymbol* symbol) {
  if (!hasScope()) return false;
  HxCSmbScopeData* const data = createScopeData(symbol);
  if (data == nullptr) return false;
  if (m_pScope->defineKey(key, data)) return true;
  delete data;
  return false;
}

bool HxCNameSpace::defineString(const KyCXString& s) {
  int key = 0;
  return keyOf(s, key) && defineIdn(key);
}

bool HxCNameSpace::defineString(const KyCXString& s, HxCSymbol* symbol) {
  int key = 0;
  return keyOf(s, key) && defineIdn(key, symbol);
}

bool HxCNameSpace::keyInScope(int key) {
  return hasScope() && m_pScope->containsInScope(key);
}

bool HxCNameSpace::stringInScope(const KyCXString& s) {
  int key = 0;
  return keyOf(s, key) && keyInScope(key);
}

bool HxCNameSpace::stringInScope(const KyCXString& s, HxCSymbol*& symbol) {
  int key = 0;
  if (!keyOf(s, key) || !hasScope()) return false;
  return symbolOf(m_pScope->lookupInScope(key), symbol, "prSymbol != 0");
}

bool HxCNameSpace::keyInEnv(int key) {
  return hasScope() && m_pScope->containsInEnv(key);
}

bool HxCNameSpace::stringInEnv(const KyCXString& s) {
  int key = 0;
  return keyOf(s, key) && keyInEnv(key);
}

bool HxCNameSpace::keyInEnv(int key, HxCSmbScopeData*& data) {
  data = hasScope() ? m_pScope->lookupInEnv(key) : nullptr;
  return data != nullptr;
}

bool HxCNameSpace::stringInEnv(const KyCXString& s, HxCSmbScopeData*& data) {
  int key = 0;
  if (keyOf(s, key)) return keyInEnv(key, data);
  data = nullptr;
  return false;
}

bool HxCNameSpace::keyInEnv(int key, HxCSymbol*& symbol) {
  HxCSmbScopeData* data = nullptr;
  keyInEnv(key, data);
  return symbolOf(data, symbol, "rpSymbol");
}

bool HxCNameSpace::stringInEnv(const KyCXString& s, HxCSymbol*& symbol) {
  int key = 0;
  return keyOf(s, key) && keyInEnv(key, symbol);
}

bool HxCNameSpace::remove(const KyCXString& s) {
  int key = 0;
  if (!keyOf(s, key) || !keyInScope(key)) return false;
  HxCSmbScopeData* const data = m_pScope->lookupInScope(key);
  m_pScope->removeKey(key);
  delete data;
  return true;
}

HxCSmbScopeData* HxCNameSpace::createScopeData(HxCSymbol* symbol) {
  return new HxCSmbScopeData(symbol);
}

bool HxCNameSpace::hasScope() const {
  return HX_Assert(m_pScope != nullptr, kNameSpaceErrorCode);
}

// The server reports by itself that the server is down.
bool HxCNameSpace::keyOf(const KyCXString& s, int& key) const {
  return HX_Assert(m_pIdServer != nullptr, kNameSpaceErrorCode) &&
         m_pIdServer->findOrAdd(s, key);
}
