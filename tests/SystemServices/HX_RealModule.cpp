// A module whose only content is the version resource.
extern "C" int HX_RealModule() { return 1; }
