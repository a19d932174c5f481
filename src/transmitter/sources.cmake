set(PAGE_SOURCES
  Qvz_MGTTransmitter.h Qvz_MGTTransmitter.cpp
  Qvz_MGTTransmitterGui.h Qvz_MGTTransmitterGui.cpp
  Qvz_MGTTXWidget.h Qvz_MGTTXWidget.cpp Qvz_MGTTXWidget.ui)
