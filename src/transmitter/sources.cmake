set(PAGE_SOURCES Qvz_MGTTransmitter.h Qvz_MGTTransmitter.cpp)
