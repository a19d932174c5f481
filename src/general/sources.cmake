set(PAGE_SOURCES Qvz_MGTGeneralSetup.h Qvz_MGTGeneralSetup.cpp
  Qvz_MGTGeneralSetupGui.h Qvz_MGTGeneralSetupGui.cpp
  GeneralSetupWidget.h GeneralSetupWidget.cpp GeneralSetupWidget.ui)
