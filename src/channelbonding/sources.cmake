set(PAGE_SOURCES
  Qvz_MGTRCB.h Qvz_MGTRCB.cpp
  Qvz_MGTRCBPlacement.h Qvz_MGTRCBPlacement.cpp
  Qvz_MGTRCBGui.h Qvz_MGTRCBGui.cpp
  Qvz_MGTRCBWidget.h Qvz_MGTRCBWidget.cpp Qvz_MGTRCBWidget.ui
  Qvz_MGTRCBConfigDialogBase.h Qvz_MGTRCBConfigDialogBase.cpp Qvz_MGTRCBConfigDialogBase.ui
  Qvz_MGTRCBConfigDialog.h Qvz_MGTRCBConfigDialog.cpp
  Qvz_MGTRCBConfig11DialogBase.h Qvz_MGTRCBConfig11DialogBase.cpp Qvz_MGTRCBConfig11DialogBase.ui
  Qvz_MGTRCBConfig11Dialog.h Qvz_MGTRCBConfig11Dialog.cpp
  Qvz_MGTRCBLaneIDDialogBase.h Qvz_MGTRCBLaneIDDialogBase.cpp Qvz_MGTRCBLaneIDDialogBase.ui
  Qvz_MGTRCBLaneIDDialog.h Qvz_MGTRCBLaneIDDialog.cpp)
