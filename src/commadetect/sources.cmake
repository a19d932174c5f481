set(PAGE_SOURCES
  Qvz_MGTRCD.h Qvz_MGTRCD.cpp
  Qvz_MGTRCDGui.h Qvz_MGTRCDGui.cpp
  Qvz_MGTRCDWidget.h Qvz_MGTRCDWidget.cpp Qvz_MGTRCDWidget.ui)
