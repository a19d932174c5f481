set(PAGE_SOURCES
  Qvz_MGTRCC.h Qvz_MGTRCC.cpp
  Qvz_MGTRCCGui.h Qvz_MGTRCCGui.cpp
  Qvz_MGTRCCWidget.h Qvz_MGTRCCWidget.cpp Qvz_MGTRCCWidget.ui)
