// What the library calls of the services around it: memory controller, dump
// writer, data dictionary and MATLAB interface. Calls of free functions stand
// in HX_PlatformContract.cpp.

#ifndef CONTRACT_HX_SERVICECONTRACT_H
#define CONTRACT_HX_SERVICECONTRACT_H

#include <concepts>

/// HxCMemController: blocks are aligned for every type; null without memory.
template <class Controller>
concept HX_MemoryContract = requires(Controller* controller, void* block,
                                     unsigned long size) {
  { controller->allocMemBlock(size) } -> std::same_as<void*>;
  controller->freeMemBlock(block);
};

/// HX_Dump and HX_Dumpable, the base class of source references.
template <class Dump, class Dumpable, class Text>
concept HX_DumpContract = std::copyable<Dumpable> &&
    requires(Dump* dump, const Dumpable* object, const Text text, int level,
             bool recursive) {
  dump->openObject(object, text);
  dump->writeEntry(text, text, level);
  dump->closeObject(object);
  object->dumpStart(dump, text);
  object->dumpFinish(dump);
  object->dump(dump, recursive);
  { object->getDumpFileName() } -> std::convertible_to<Text>;
  { object->getNameForDump() } -> std::convertible_to<Text>;
  { object->getLinkNameForDump() } -> std::convertible_to<Text>;
  { object->getColorForDump() } -> std::convertible_to<Text>;
};

/// HX_DataDictionary: false, with the text unchanged, for an unknown handle.
template <class Dictionary, class Text>
concept HX_DataDictionaryContract = requires(unsigned long handle, Text text) {
  { Dictionary::isValidDdHandle(handle) } -> std::convertible_to<bool>;
  {
    Dictionary::getObjectFullPathName(handle, text)
    } -> std::convertible_to<bool>;
  { Dictionary::getObjectName(handle, text) } -> std::convertible_to<bool>;
};

/// kyddapi: texts and lists handed out go back through DDAPIHeapFree().
template <class Object, class Component, class Node>
concept HX_DictionaryClientContract = std::derived_from<Component, Object> &&
    requires(Object object, const Object constant, const Component component,
             const Node* node, unsigned long handle, const char* path,
             long count, unsigned short kind, char* text, unsigned long length,
             unsigned short shortLength) {
  Object(handle);
  Component(handle);
  object.ConnectToDDObject(path);
  object.ConnectToDDObject(handle);
  { constant.GetHandle() } -> std::same_as<unsigned long>;
  { constant.GetChildObjects(kind, count, kind) } -> std::same_as<Node*>;
  { node->next } -> std::convertible_to<const Node*>;
  { node->handle } -> std::convertible_to<unsigned long>;
  { constant.GetNumOfProps() } -> std::convertible_to<long>;
  {
    constant.ReadRefPathFromDDK(count, text, length, kind)
    } -> std::convertible_to<bool>;
  constant.GetPropertyName(text, shortLength, count);
  constant.GetName(text, shortLength);
  { component.GetRelatedVariables(kind) } -> std::convertible_to<Object>;
};

/// HX_SimulinkInterface and HX_MxArrayConverter. getMxSlData() gives a new
/// array or null; the converter answers false for an array of a different kind
/// and for null.
template <class Interface, class Converter, class Array, class Text>
concept HX_SimulinkContract = std::default_initializable<Converter> &&
    requires(const Converter converter, Array* object, const Array* constant,
             Text text, double number) {
  { Interface::s_invalidHandle } -> std::convertible_to<double>;
  { Interface::getMxSlData(object, text) } -> std::same_as<Array*>;
  { converter.mxArrayToString(constant, text) } -> std::convertible_to<bool>;
  { converter.mxArrayToDouble(constant, number) } -> std::convertible_to<bool>;
};

#endif  // CONTRACT_HX_SERVICECONTRACT_H
