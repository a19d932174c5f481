set(PAGE_SOURCES
  Qvz_MGTRCB.h Qvz_MGTRCB.cpp
  Qvz_MGTRCBPlacement.h Qvz_MGTRCBPlacement.cpp)
