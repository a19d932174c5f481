set(PAGE_SOURCES Qvz_MGTGeneralSetup.h Qvz_MGTGeneralSetup.cpp Qvz_MGTFinalizePins.cpp)
