#include "platform/datadictionary/HX_DataDictionary.h"

#include "platform/datadictionary/HX_DdTree.h"
#include "platform/strings/KyCXString.h"

bool HX_DataDictionary::isValidDdHandle(unsigned long handle) {
  return HX_DdTree::instance().isValid(handle);
}

bool HX_DataDictionary::getObjectFullPathName(unsigned long handle,
                                              KyCXString& path) {
  if (!isValidDdHandle(handle)) return false;
  path = HX_DdTree::instance().path(handle).c_str();
  return true;
}

bool HX_DataDictionary::getObjectName(unsigned long handle, KyCXString& name) {
  if (!isValidDdHandle(handle)) return false;
  name = HX_DdTree::instance().name(handle).c_str();
  return true;
}
