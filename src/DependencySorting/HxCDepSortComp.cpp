#include "DependencySorting/HxCDepSortComp.h"

HxCDepSortComp::~HxCDepSortComp() = default;
