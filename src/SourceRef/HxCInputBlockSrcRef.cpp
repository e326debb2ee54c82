#include "SourceRef/HxCInputBlockSrcRef.h"

#include <algorithm>
#include <bit>
#include <cstdint>
#include <memory>
#include <utility>
#include <vector>

#include "Control/HX_Memory.h"
#include "Control/HX_SelfCheck.h"
#include "platform/matlab/HX_MxArrayConverter.h"
#include "platform/matlab/HX_SimulinkInterface.h"
#include "platform/model/HX_BlockDataBase.h"
#include "platform/model/HX_InputBlockId.h"
#include "platform/model/HxCGlobal.h"

namespace {

struct ArrayDeleter {
  void operator()(mxArray* array) const { mxDestroyArray(array); }
};
using OwnedArray = std::unique_ptr<mxArray, ArrayDeleter>;

OwnedArray read(mxArray* object, const char* parameter) {
  return OwnedArray(HX_SimulinkInterface::getMxSlData(object, parameter));
}

bool readName(mxArray* object, KyCXString& name) {
  const OwnedArray value = read(object, "Name");
  return HX_MxArrayConverter().mxArrayToString(value.get(), name);
}

bool readHandle(mxArray* object, double& handle) {
  const OwnedArray value = read(object, "Handle");
  return HX_MxArrayConverter().mxArrayToDouble(value.get(), handle);
}

// Handle of the object that the latest getBlockName() read.
double s_ObjectHandle = 0.0;

// Handles met on a climb, as bit patterns, so that NaN equals NaN.
class MetHandles {
 public:
  /// False if \p handle was entered before.
  bool enter(double handle) {
    const auto bits = std::bit_cast<std::uint64_t>(handle);
    if (std::find(m_Handles.begin(), m_Handles.end(), bits) != m_Handles.end())
      return false;
    m_Handles.push_back(bits);
    return true;
  }

 private:
  // Few: one per level of the model.
  std::vector<std::uint64_t, HX_ControllerAllocator<std::uint64_t>> m_Handles;
};

}  // namespace

HxCInputBlockSrcRef::HxCInputBlockSrcRef(const HX_InputBlockId& id)
    : m_pInputBlock(&id) {}

HxCInputBlockSrcRef::~HxCInputBlockSrcRef() = default;

const HxCInputBlockSrcRef* HxCInputBlockSrcRef::isInputBlock() const {
  return this;
}

void HxCInputBlockSrcRef::toString(KyCXString& text) const {
  HX_WithinMemory([&] {
    KyCXString path(text);
    MetHandles met;
    OwnedArray object(mxCreateScalarDouble(getBlockHandle()));
    bool isFirst = true;
    for (bool atRoot = false; !atRoot; isFirst = false) {
      KyCXString name;
      mxArray* parent = nullptr;
      const bool success = getBlockName(object.get(), name, parent, atRoot);
      object.reset(parent);
      if (!success) break;
      const bool isNew = met.enter(s_ObjectHandle);
      if (!HX_DebugCheck(isNew, "isNew")) break;
      path = isFirst ? name : name + "/" + path;
    }
    path.replaceWhiteSpace(' ', false);
    text = std::move(path);
  });
}

bool HxCInputBlockSrcRef::getBlockName(mxArray* object, KyCXString& name,
                                       mxArray*& parent, bool& atRoot) const {
  atRoot = false;
  name = "";
  parent = nullptr;
  const bool hasName = readName(object, name);
  const OwnedArray root(mxCreateString(GLB_GetFullSystemPath().cstring()));
  double rootHandle = HX_SimulinkInterface::s_invalidHandle;
  const bool hasRoot = readHandle(root.get(), rootHandle);
  const bool hasHandle = readHandle(object, s_ObjectHandle);
  atRoot = hasRoot && hasHandle && s_ObjectHandle == rootHandle;
  parent = read(object, "Parent").release();
  const bool success = hasName && hasRoot && hasHandle && parent != nullptr;
  return HX_DebugCheck(success, "success");
}

HxCSrcRef* HxCInputBlockSrcRef::clone() const {
  return new HxCInputBlockSrcRef(*m_pInputBlock);
}

double HxCInputBlockSrcRef::getBlockHandle() const {
  const HX_BlockDataBase& blocks = m_pInputBlock->getBlockDataBase();
  return blocks.getSlBlockHandle(m_pInputBlock->getBlockId());
}
