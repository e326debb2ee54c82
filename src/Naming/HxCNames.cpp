#include "Naming/HxCNames.h"

HxCNames::~HxCNames() = default;
