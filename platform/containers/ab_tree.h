// Selects a balanced search tree as the implementation of leda::dictionary.

#ifndef PLATFORM_CONTAINERS_AB_TREE_H
#define PLATFORM_CONTAINERS_AB_TREE_H

namespace leda {

class ab_tree;

}  // namespace leda

#endif  // PLATFORM_CONTAINERS_AB_TREE_H
