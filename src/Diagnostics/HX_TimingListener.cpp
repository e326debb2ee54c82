#include "Diagnostics/HX_TimingListener.h"

HX_TimingListener* HX_TimingListener::s_pListener = nullptr;

HX_TimingListener::~HX_TimingListener() = default;
