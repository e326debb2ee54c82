#include "platform/dump/HX_Dumpable.h"

#include "platform/dump/HX_Dump.h"

HX_Dump::~HX_Dump() = default;

HX_Dumpable::~HX_Dumpable() = default;

KyCXString HX_Dumpable::getDumpFileName() const { return {}; }

KyCXString HX_Dumpable::getNameForDump() const { return {}; }

KyCXString HX_Dumpable::getLinkNameForDump() const { return {}; }

KyCXString HX_Dumpable::getColorForDump() const { return {}; }

void HX_Dumpable::dumpStart(HX_Dump*, const KyCXString&) const {}

void HX_Dumpable::dumpFinish(HX_Dump*) const {}

void HX_Dumpable::dump(HX_Dump*, bool) const {}
