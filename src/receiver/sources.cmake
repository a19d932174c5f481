set(PAGE_SOURCES
  Qvz_MGTRX.h Qvz_MGTRX.cpp
  Qvz_MGTRXGui.h Qvz_MGTRXGui.cpp
  Qvz_MGTRXWidget.h Qvz_MGTRXWidget.cpp Qvz_MGTRXWidget.ui)
