#include "platform/os/HX_ClockSource.h"

HX_ClockSource* HX_ClockSource::s_pSource = nullptr;

HX_ClockSource::~HX_ClockSource() = default;
