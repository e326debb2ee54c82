#include "host/names/HX_Components.h"

#include <algorithm>
#include <set>

#include "Naming/HxCCIdentifier.h"
#include "host/base/HX_NameText.h"
#include "host/base/HX_NaturalOrder.h"
#include "host/names/HX_FormedName.h"
#include "platform/model/HX_Block.h"

namespace {

std::vector<std::string> pathsOf(const HX_Model& model) {
  std::set<const HX_Block*> around;  // asked, never walked
  int outermost = 0;
  for (const auto& block : model.blocks) {
    around.insert(block->getParent());
    outermost += block->getParent() == nullptr ? 1 : 0;
  }
  std::vector<std::string> paths;
  for (const auto& block : model.blocks) {
    const HX_Block* parent = block->getParent();
    const bool isOutermost =
        outermost == 1 ? parent != nullptr && parent->getParent() == nullptr
                       : parent == nullptr;
    if (isOutermost && around.count(block.get()) > 0)
      paths.push_back(HX_PathOf(block->getSrcRef()));
  }
  std::sort(paths.begin(), paths.end(), HX_NaturalLess);
  paths.erase(std::unique(paths.begin(), paths.end()), paths.end());
  return paths;
}

std::string lastNameOf(const std::string& path) {
  return path.substr(path.rfind('/') + 1);
}

// File systems that fold case must keep the files apart.
std::string folded(std::string text) {
  for (char& c : text)
    if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
  return text;
}

std::string stemOf(const std::string& model, const std::string& path,
                   std::set<std::string>& taken) {
  const KyCXString wanted = HX_NameText(model + "_" + lastNameOf(path));
  HxCCIdentifier id(wanted);
  // Without this, the "$R" of templates would become part of the name.
  id.setCookedName(wanted, HxCCIdentifier::eActualName);
  id.makeCIdentifier();
  KyCXString text = id.getCookedName(HxCCIdentifier::eActualName);
  text.shortenString(120, 2, '_', KyCXString::ePositionMiddle);
  std::string stem = text.cstring();
  for (int i = 2; !taken.insert(folded(stem)).second; ++i)
    stem = text.cstring() + ("_" + std::to_string(i));
  return stem;
}

}  // namespace

HX_Components::HX_Components(const HX_Model& model) {
  const HX_CFiles whole = HX_CFiles::ofModel();
  m_All.push_back({".", whole});
  std::set<std::string> taken = {folded(whole.code), folded(whole.types)};
  for (const std::string& path : pathsOf(model)) {
    m_ByPath.emplace(path, static_cast<int>(m_All.size()));
    m_All.push_back({path, {whole.types, stemOf(whole.code, path, taken)}});
  }
  for (const HX_WantedName& name : model.names)
    if (name.body != nullptr) m_FunctionOf.emplace(name.body, &name);
}

int HX_Components::find(const std::string& path) const {
  if (path == ".") return 0;
  const auto found = m_ByPath.find(path);
  return found != m_ByPath.end() ? found->second : -1;
}

int HX_Components::of(const HX_WantedName& name) const {
  const HX_WantedName* owner = &name;
  for (const HX_ScopeItem* scope = name.scope; scope != nullptr;
       scope = scope->parent) {
    const auto function = m_FunctionOf.find(scope);
    if (function != m_FunctionOf.end()) owner = function->second;
  }
  // The longest path of a component in front; names may contain '/'.
  std::string path = HX_PathOf(HX_BestSource(*owner));
  while (!path.empty()) {
    const auto found = m_ByPath.find(path);
    if (found != m_ByPath.end()) return found->second;
    path.resize(path.rfind('/') == path.npos ? 0 : path.rfind('/'));
  }
  return 0;
}
