// Random cases for the library and for the plain form: models, calls, answers.

#ifndef PLAIN_HX_PLAINCASE_H
#define PLAIN_HX_PLAINCASE_H

#include <deque>
#include <memory>

#include "SourceRef/HxCDdSrcRef.h"
#include "SourceRef/HxCInputBlockSrcRef.h"
#include "SourceRef/HxCInternalSrcRef.h"
#include "SourceRef/HxCStateflowSrcRef.h"
#include "plain/HX_PlainChoices.h"
#include "plain/HX_PlainModel.h"
#include "platform/datatypes/HX_DataTypeServer.h"
#include "platform/datatypes/HX_NumericalType.h"
#include "platform/matlab/HX_SimulinkTree.h"
#include "platform/model/HX_BdBlock.h"
#include "platform/model/HX_BlockDataBase.h"
#include "platform/model/HX_InputBlockId.h"
#include "platform/model/HX_IvData.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HX_SlBlockHandlesDB.h"
#include "platform/model/HX_StateflowBlock.h"
#include "platform/model/HxCSymbol.h"
#include "platform/model/SC_Chart.h"
#include "platform/model/SC_State.h"

namespace plain {

/// Checks for smallestDifference(): identifiers, names and keywords; source
/// references, sets and server.
std::string differenceOfNames(const std::string& bytes, std::string* log);
std::string differenceOfSrcRefs(const std::string& bytes, std::string* log);

Model randomModel(Choices& choices);

KyCXString kyText(const Text& text);
Text textOf(const KyCXString& text);

template <class T>
T* pointerTo(T& entry) {
  return &entry;
}
template <class T>
T* pointerTo(std::unique_ptr<T>& entry) {
  return entry.get();
}
template <class T>
T* pointerTo(T*& entry) {
  return entry;
}
/// Entry \p i of objects or pointers; null for kNone.
template <class T>
auto* entry(T& all, int i) {
  using Pointer = decltype(pointerTo(all[0]));
  return i == kNone ? Pointer() : pointerTo(all[static_cast<std::size_t>(i)]);
}

/// The model in the classes of the library, and the model of the process.
/// Gives the handles of the dictionary and of the input blocks to the plain
/// model.
class LibraryModel {
 public:
  explicit LibraryModel(Model& model);
  LibraryModel(const LibraryModel&) = delete;
  LibraryModel& operator=(const LibraryModel&) = delete;
  ~LibraryModel();

  std::size_t ownRefs() const { return blocks.size() + objects.size(); }
  /// The index of a reference, kNone for null.
  int indexOf(const HxCSrcRef* ref) const;
  /// Messages since the last call, as of the plain form.
  std::vector<std::string> takeMessages() const;

  std::deque<std::unique_ptr<HX_Block>> blocks;
  std::deque<std::unique_ptr<SC_Model>> objects;
  std::deque<HX_BdBlock> ivBlocks;
  std::deque<HX_DataType> types;
  std::deque<HxCSymbol> symbols;
  std::deque<std::unique_ptr<HX_InputBlockId>> inputs;
  std::vector<const HxCSrcRef*> refs;
  int firstNumber = 0;  // of the references

 private:
  void makeTypes(const Model& model);
  void makeDictionary(Model& model);
  void makeRefs(const Model& model);

  std::deque<SC_Chart> m_Charts;
  std::deque<std::unique_ptr<HxCSrcRef>> m_OwnedRefs;
  HX_NumericalType m_Signed{-1.0, 1.0, 64, true};
  HX_NumericalType m_Unsigned{0.0, 1.0, 64, false};
  HX_OptionsExt m_Options;
  HX_DataTypeServer m_TypeServer;
  HX_BcPartitionContext m_Context;
  HX_BdPartition m_Partition;
  HxCIvData m_IvData;
  HX_SlBlockHandlesDB m_Handles;
  HX_SimulinkTree m_Tree;
  HX_BlockDataBase m_InputHandles;
};

/// The first line that differs, after the common lines; empty without one.
std::string firstDifference(const std::vector<std::string>& calls,
                            const std::vector<std::string>& library,
                            const std::vector<std::string>& plain);

}  // namespace plain

#endif  // PLAIN_HX_PLAINCASE_H
