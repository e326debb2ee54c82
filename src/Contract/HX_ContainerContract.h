// What the library calls of a host's containers in namespace leda.
//
// Containers are value types unless the comment of a concept says otherwise.
// An item names a place in a container; a null item converts to false.

#ifndef CONTRACT_HX_CONTAINERCONTRACT_H
#define CONTRACT_HX_CONTAINERCONTRACT_H

#include <concepts>

/// leda::array: indices from low() to high(), elements consecutive in memory.
template <class Array, class Element>
concept HX_ArrayContract = std::default_initializable<Array> &&
    std::copyable<Array> &&
    requires(Array array, const Array constant, int index) {
  Array(index);
  array.resize(index);
  { constant.size() } -> std::convertible_to<int>;
  { constant.high() } -> std::convertible_to<int>;
  { array[index] } -> std::same_as<Element&>;
  { constant[index] } -> std::same_as<const Element&>;
};

/// leda::stack: last in, first out.
template <class Stack, class Element>
concept HX_StackContract = std::default_initializable<Stack> &&
    std::copyable<Stack> &&
    requires(Stack stack, const Stack constant, const Element element) {
  stack.push(element);
  { stack.pop() } -> std::convertible_to<Element>;
  { constant.empty() } -> std::convertible_to<bool>;
};

/// leda::list: items stay valid while other items come and go. Not copied.
template <class List, class Element>
concept HX_ListContract = std::default_initializable<List> &&
    requires(List list, const List constant, const Element element,
             decltype(list.first()) item) {
  list.append(element);
  list.del_item(item);
  { list[item] } -> std::convertible_to<Element>;
  { list.pop() } -> std::convertible_to<Element>;
  { constant.empty() } -> std::convertible_to<bool>;
  { constant.first() } -> std::same_as<decltype(item)>;
  { constant.succ(item) } -> std::same_as<decltype(item)>;
  static_cast<bool>(item);
};

/// leda::dictionary: each key at most once, ascending by leda::compare.
/// insert() of a key that is present replaces the information.
template <class Dictionary, class Key, class Inf>
concept HX_DictionaryContract = std::default_initializable<Dictionary> &&
    std::copyable<Dictionary> &&
    requires(Dictionary dictionary, const Dictionary constant, const Key key,
             const Inf inf, decltype(dictionary.first_item()) item) {
  dictionary.insert(key, inf);
  dictionary.del(key);
  dictionary.clear();
  { dictionary[item] } -> std::same_as<Inf&>;
  { constant.size() } -> std::convertible_to<int>;
  { constant.key(item) } -> std::convertible_to<Key>;
  { constant.inf(item) } -> std::convertible_to<Inf>;
  { constant.lookup(key) } -> std::same_as<decltype(item)>;
  { constant.first_item() } -> std::same_as<decltype(item)>;
  { constant.next_item(item) } -> std::same_as<decltype(item)>;
  static_cast<bool>(item);
};

/// leda::integer: sign and magnitude; word 0 of the magnitude is the least
/// significant one. Constants of the type are set before any code runs.
template <class Integer>
concept HX_IntegerContract = std::default_initializable<Integer> &&
    std::copyable<Integer> &&
    requires(const Integer integer, int small, unsigned int word) {
  Integer(small);
  Integer(word);
  { integer + integer } -> std::convertible_to<Integer>;
  { integer << small } -> std::convertible_to<Integer>;
  { integer < integer } -> std::convertible_to<bool>;
  { integer > integer } -> std::convertible_to<bool>;
  { integer.used_words() } -> std::convertible_to<int>;
  { integer.contents(small) } -> std::convertible_to<unsigned int>;
};

#endif  // CONTRACT_HX_CONTAINERCONTRACT_H
