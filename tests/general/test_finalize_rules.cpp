// The pin rules of the finish routine, one minimal block per case, and the
// helpers the routine builds ports, buses and ties with.

#include "FinalizeSupport.h"
#include "Qvz_Summary.h"

#include <gtest/gtest.h>

#include <climits>

namespace {

using F = Qvz_Family;

struct RuleCase {
    const char* label;
    F family;
    // Pin text (see FinishBench::AddPin). Rule cases use outputs unless they
    // are about inputs: an input left unconnected is grounded at the end,
    // which would hide the difference between "unconnected" and "tie 0".
    const char* pin;
    const char* settings;
    const char* expect;
    const char* pinAttrs = "";
    // Pre-wire the pin with a bit map, to see it left as it is.
    bool preset = false;
};

const RuleCase kRules[] = {
    {"0 PCS pin, PCS bypassed", F::GT10, "RXCOMMADET/OUT", "QVZX_ONLY_BYPASS_PCS=TRUE",
     "unconnected"},
    {"0 PCS pin, PCS in use", F::GT10, "RXCOMMADET/OUT", "", "port RXCOMMADET_OUT/1"},

    {"1 REFCLK static, REFCLK2 chosen", F::GT10, "REFCLK/OUT",
     "QVZX_ONLY_REFCLK_DYN=STATIC;QVZX_ONLY_REFCLK=REFCLK2", "tie 0"},
    {"1 REFCLK unused on GT10", F::GT10, "REFCLK/OUT", "QVZX_ONLY_USE_REFCLK=FALSE", "unconnected"},
    {"1 REFCLK unused on GT with BREFCLK", F::GT, "REFCLK/OUT", "REF_CLK_V_SEL=1", "unconnected"},
    {"1 REFCLK, no condition", F::GT10, "REFCLK/OUT", "", "port REFCLK_OUT/1"},
    {"2 REFCLK2 on GT11", F::GT11, "REFCLK2/OUT", "QVZX_ONLY_REFCLK_DYN=STATIC",
     "port REFCLK2_OUT/1"},
    {"2 REFCLK2 static, not chosen", F::GT10, "REFCLK2/OUT",
     "QVZX_ONLY_REFCLK_DYN=STATIC;QVZX_ONLY_REFCLK=REFCLK1", "tie 0"},
    {"2 REFCLK2 unused", F::GT10, "REFCLK2/OUT", "QVZX_ONLY_USE_REFCLK=FALSE", "unconnected"},
    {"3 BREFCLK static, BREFCLK2 chosen", F::GT10, "BREFCLK/OUT",
     "QVZX_ONLY_BREFCLK_DYN=STATIC;QVZX_ONLY_BREFCLK=BREFCLK2", "tie 0"},
    {"3 BREFCLK beside REFCLK", F::GT10, "BREFCLK/OUT", "", "unconnected"},
    {"3 BREFCLK without REFCLK", F::GT10, "BREFCLK/OUT", "QVZX_ONLY_USE_REFCLK=FALSE",
     "port BREFCLK_OUT/1"},
    {"4 BREFCLK2 static, not chosen", F::GT10, "BREFCLK2/OUT",
     "QVZX_ONLY_BREFCLK_DYN=STATIC;QVZX_ONLY_BREFCLK=BREFCLK", "tie 0"},
    {"4 BREFCLK2 beside REFCLK on GT", F::GT, "BREFCLK2/OUT", "REF_CLK_V_SEL=0", "unconnected"},
    {"4 BREFCLK2 without REFCLK on GT", F::GT, "BREFCLK2/OUT", "REF_CLK_V_SEL=1",
     "port BREFCLK2_OUT/1"},
    {"5 BREFCLKPIN, BREFCLK unused", F::GT10, "BREFCLKPIN/OUT", "QVZX_ONLY_USE_BREFCLK=FALSE",
     "unconnected"},
    {"5 BREFCLKNIN, BREFCLK used", F::GT10, "BREFCLKNIN/OUT", "", "port BREFCLKNIN_OUT/1"},
    {"6 REFCLKSEL static REFCLK2", F::GT10, "REFCLKSEL/OUT",
     "QVZX_ONLY_REFCLK_DYN=STATIC;QVZX_ONLY_REFCLK=REFCLK2", "tie 1"},
    {"6 REFCLKSEL static REFCLK1", F::GT10, "REFCLKSEL/OUT", "QVZX_ONLY_REFCLK_DYN=STATIC",
     "tie 0"},
    {"6 REFCLKSEL by static BREFCLK2 on GT", F::GT, "REFCLKSEL/OUT",
     "REF_CLK_V_SEL=1;QVZX_ONLY_BREFCLK_DYN=STATIC;QVZX_ONLY_BREFCLK=BREFCLK2", "tie 1"},
    {"6 REFCLKSEL dynamic", F::GT10, "REFCLKSEL/OUT", "", "port REFCLKSEL_OUT/1"},
    {"7 REFCLKBSEL, REFCLK only", F::GT10, "REFCLKBSEL/OUT", "QVZX_ONLY_USE_BREFCLK=FALSE",
     "tie 0"},
    {"7 REFCLKBSEL, BREFCLK only", F::GT10, "REFCLKBSEL/OUT", "QVZX_ONLY_USE_REFCLK=FALSE",
     "tie 1"},
    {"7 REFCLKBSEL, both clocks", F::GT10, "REFCLKBSEL/OUT", "", "port REFCLKBSEL_OUT/1"},
    {"8 PMAREGADDR, PMA off", F::GT10, "PMAREGADDR/OUT/6", "", "tie 0"},
    {"8 PMAINIT, PMA on", F::GT10, "PMAINIT/OUT", "QVZX_ONLY_ENABLE_PMA=TRUE",
     "port PMAINIT_OUT/1"},
    {"9 COMBUSOUT", F::GT10, "COMBUSOUT/OUT/16", "", "maps 0_0=PRE[0:0]", "", true},
    {"10 CONFIGOUT", F::GT10, "CONFIGOUT/OUT", "", "unconnected"},
    {"10 CONFIGENABLE", F::GT10, "CONFIGENABLE/OUT", "", "tie 0"},
    {"11 CHBONDI", F::GT10, "CHBONDI/OUT/5", "", "unconnected"},
    // Names of rules 1 to 11 end the rules even when later ones would apply.
    {"1 REFCLK, neither direction used", F::GT10, "REFCLK/OUT",
     "QVZ_BOOL_RX_USE=FALSE;QVZ_BOOL_TX_USE=FALSE", "port REFCLK_OUT/1"},
    {"8 PMAINIT, neither direction used", F::GT11, "PMAINIT/OUT",
     "QVZX_ONLY_ENABLE_PMA=TRUE;QVZ_BOOL_RX_USE=FALSE;QVZ_BOOL_TX_USE=FALSE", "port PMAINIT_OUT/1"},

    {"12 RXN, transmitter only", F::GT10, "RXN/OUT", "QVZ_BOOL_RX_USE=FALSE", "port RXN_OUT/1"},
    {"12 RXP, neither direction", F::GT10, "RXP/OUT", "QVZ_BOOL_RX_USE=FALSE;QVZ_BOOL_TX_USE=FALSE",
     "unconnected"},
    {"12 RXN, receiver used", F::GT10, "RXN/OUT", "", "port RXN_OUT/1"},
    {"13 CHBONDO, bonding number 1", F::GT10, "CHBONDO/OUT/5", "QVZ_CHAN_BOND_NUMBER=1",
     "unconnected"},
    {"13 CHBONDO, bonded", F::GT10, "CHBONDO/OUT/5", "QVZ_CHAN_BOND_NUMBER=4",
     "wire CHANBOND_M_S1_OUT/5"},
    {"13 CHBONDO, bonding switched off", F::GT10, "CHBONDO/OUT/5",
     "QVZ_CHAN_BOND_NUMBER=4;CHAN_BOND_MODE=OFF", "unconnected"},
    {"13 CHBONDO, negative bonding number", F::GT10, "CHBONDO/OUT/5", "QVZ_CHAN_BOND_NUMBER=-4",
     "unconnected"},
    {"13 CHBONDO, receiver unused", F::GT10, "CHBONDO/OUT/5",
     "QVZ_BOOL_RX_USE=FALSE;QVZ_CHAN_BOND_NUMBER=4", "unconnected"},
    {"14 TXP, receiver only", F::GT10, "TXP/OUT", "QVZ_BOOL_TX_USE=FALSE", "port TXP_OUT/1"},
    {"14 TXN, neither direction", F::GT10, "TXN/OUT", "QVZ_BOOL_RX_USE=FALSE;QVZ_BOOL_TX_USE=FALSE",
     "unconnected"},
    {"15 CHBONDDONE, no bonding", F::GT10, "CHBONDDONE/OUT", "", "unconnected"},
    {"15 ENCHANSYNC, bonded", F::GT10, "ENCHANSYNC/OUT", "QVZ_CHAN_BOND_NUMBER=2",
     "port ENCHANSYNC_OUT/1"},

    {"16 RXCRCPD, CRC on", F::GT11, "RXCRCPD/OUT", "QVZ_RXCRC_USE=TRUE", "tie 1"},
    {"16 RXCRCPD, CRC off", F::GT11, "RXCRCPD/OUT", "", "tie 0"},
    {"16 RXCRCDATAWIDTH 32", F::GT11, "RXCRCDATAWIDTH/IN/3",
     "QVZ_RXCRC_USE=TRUE;QVZ_RXCRC_DATAWIDTH=32",
     "port RXCRCDATAWIDTH_IN/3 + maps 2_2=CRCDATAWIDTH_GND[0:0],1_1=CRCDATAWIDTH_VCC[0:0],"
     "0_0=CRCDATAWIDTH_VCC[0:0]"},
    {"16 RXCRCDATAWIDTH 8", F::GT11, "RXCRCDATAWIDTH/IN/3",
     "QVZ_RXCRC_USE=TRUE;QVZ_RXCRC_DATAWIDTH=8",
     "port RXCRCDATAWIDTH_IN/3 + maps 2_2=CRCDATAWIDTH_GND[0:0],1_1=CRCDATAWIDTH_GND[0:0],"
     "0_0=CRCDATAWIDTH_GND[0:0]"},
    {"16 RXCRCDATAWIDTH narrower than the code", F::GT11, "RXCRCDATAWIDTH/IN/2",
     "QVZ_RXCRC_USE=TRUE;QVZ_RXCRC_DATAWIDTH=40",
     "port RXCRCDATAWIDTH_IN/2 + maps 1_1=CRCDATAWIDTH_GND[0:0],0_0=CRCDATAWIDTH_GND[0:0]"},
    {"16 RXCRCERR, CRC off", F::GT11, "RXCRCERR/OUT", "", "unconnected"},
    {"16 RXCRCOUT, CRC on", F::GT11, "RXCRCOUT/OUT/2", "QVZ_RXCRC_USE=TRUE", "port RXCRCOUT_OUT/2"},
    {"17 TXCRCPD, CRC on", F::GT11, "TXCRCPD/OUT", "TX_CRC_USE=TRUE", "tie 1"},
    {"17 TXCRCDATAWIDTH 64", F::GT11, "TXCRCDATAWIDTH/IN/3",
     "QVZ_TXCRC_USE=TRUE;QVZ_TXCRC_DATAWIDTH=64",
     "port TXCRCDATAWIDTH_IN/3 + maps 2_2=CRCDATAWIDTH_VCC[0:0],1_1=CRCDATAWIDTH_VCC[0:0],"
     "0_0=CRCDATAWIDTH_VCC[0:0]"},
    {"17 TXCRCIN, CRC off", F::GT11, "TXCRCIN/OUT/64", "", "unconnected"},
    {"17 TXCRCPD, transmitter unused", F::GT11, "TXCRCPD/OUT",
     "QVZ_BOOL_TX_USE=FALSE;TX_CRC_USE=TRUE", "unconnected"},
    {"18 TXFORCECRCERR, no CRC", F::GT10, "TXFORCECRCERR/OUT", "", "unconnected"},
    {"18 TXFORCECRCERR, CRC", F::GT10, "TXFORCECRCERR/OUT", "QVZ_TXCRC_USE=TRUE",
     "port TXFORCECRCERR_OUT/1"},
    {"18 TXFORCECRCERR, PCS bypassed (rule 0 first)", F::GT10, "TXFORCECRCERR/OUT",
     "QVZ_TXCRC_USE=TRUE;QVZX_ONLY_BYPASS_PCS=TRUE", "unconnected"},

    {"19 TXBYPASS8B10B, PCS bypassed", F::GT10, "TXBYPASS8B10B/OUT",
     "QVZX_ONLY_BYPASS_PCS=TRUE;QVZX_ONLY_ENCODING=DYNAMIC", "tie 1"},
    {"19 TXBYPASS8B10B, transmitter unused", F::GT10, "TXBYPASS8B10B/OUT", "QVZ_BOOL_TX_USE=FALSE",
     "tie 0"},
    {"19 TXBYPASS8B10B, no encoder", F::GT10, "TXBYPASS8B10B/OUT", "QVZX_ONLY_ENCODING=DISABLE",
     "tie 1"},
    {"19 TXBYPASS8B10B, static 8B/10B", F::GT10, "TXBYPASS8B10B/OUT",
     "QVZX_ONLY_ENCODING=STATIC;QVZX_ONLY_ENC_STATIC=8B10B", "tie 0"},
    {"19 TXBYPASS8B10B, static 64B/66B on GT10", F::GT10, "TXBYPASS8B10B/OUT",
     "QVZX_ONLY_ENCODING=STATIC;QVZX_ONLY_ENC_STATIC=64B66B", "tie 1"},
    {"19 TXBYPASS8B10B, static 64B/66B on GT11", F::GT11, "TXBYPASS8B10B/OUT",
     "QVZX_ONLY_ENCODING=STATIC;QVZX_ONLY_ENC_STATIC=64B66B", "port TXBYPASS8B10B_OUT/1"},
    {"19 TXBYPASS8B10B, dynamic", F::GT10, "TXBYPASS8B10B/OUT", "QVZX_ONLY_ENCODING=DYNAMIC",
     "port TXBYPASS8B10B_OUT/1"},
    {"20 RXDEC8B10BUSE, no decoder", F::GT10, "RXDEC8B10BUSE/OUT", "", "tie 0"},
    {"20 RXDEC8B10BUSE, static 8B/10B", F::GT10, "RXDEC8B10BUSE/OUT", "QVZX_ONLY_DECODING=STATIC",
     "tie 1"},
    {"20 RXDEC8B10BUSE, static 64B/66B", F::GT10, "RXDEC8B10BUSE/OUT",
     "QVZX_ONLY_DECODING=STATIC;QVZX_ONLY_DEC_STATIC=64B66B", "tie 0"},
    {"20 RXDEC8B10BUSE, dynamic", F::GT10, "RXDEC8B10BUSE/OUT", "QVZX_ONLY_DECODING=DYNAMIC",
     "port RXDEC8B10BUSE_OUT/1"},
    {"20 RXDEC8B10BUSE, receiver unused", F::GT10, "RXDEC8B10BUSE/OUT",
     "QVZ_BOOL_RX_USE=FALSE;QVZX_ONLY_DECODING=DYNAMIC", "unconnected"},
    {"21 RXNOTINTABLE, no decoder", F::GT10, "RXNOTINTABLE/OUT/8/dw", "", "unconnected"},
    {"21 RXDISPERR, decoder", F::GT10, "RXDISPERR/OUT/8/dw", "QVZX_ONLY_DECODING=DYNAMIC",
     "port RXDISPERR_OUT/4"},
    {"22 RXCRCERR, RX CRC off", F::GT10, "RXCRCERR/OUT", "RX_CRC_USE=FALSE", "unconnected"},
    {"22 RXCHECKINGCRC", F::GT10, "RXCHECKINGCRC/OUT", "", "port RXCHECKINGCRC_OUT/1"},
    {"23 TXKERR, no encoder on GT10", F::GT10, "TXKERR/OUT/8/dw", "", "unconnected"},
    {"23 TXCHARISK, no encoder on a fixed GT primitive", F::GT, "TXCHARISK/OUT/4/dw",
     "prim=GT_FIBRE_CHAN", "port TXCHARISK_OUT/4"},
    {"23 TXKERR, encoder", F::GT10, "TXKERR/OUT/8/dw", "QVZX_ONLY_ENCODING=DYNAMIC",
     "port TXKERR_OUT/4"},
    {"24 TXENC8B10BUSE, no encoder", F::GT10, "TXENC8B10BUSE/OUT", "", "tie 0"},
    {"24 TXENC8B10BUSE, static 8B/10B", F::GT11, "TXENC8B10BUSE/OUT", "QVZX_ONLY_ENCODING=STATIC",
     "tie 1"},
    {"24 TXENC8B10BUSE, static 64B/66B", F::GT10, "TXENC8B10BUSE/OUT",
     "QVZX_ONLY_ENCODING=STATIC;QVZX_ONLY_ENC_STATIC=64B66B", "tie 0"},
    {"24 TXENC8B10BUSE, dynamic", F::GT10, "TXENC8B10BUSE/OUT", "QVZX_ONLY_ENCODING=DYNAMIC",
     "port TXENC8B10BUSE_OUT/1"},
    {"24 TXENC8B10BUSE on GT", F::GT, "TXENC8B10BUSE/OUT", "", "port TXENC8B10BUSE_OUT/1"},

    {"25 TXDATA, no encoder", F::GT10, "TXDATA/IN/64/dw", "", "maps 0_0=PRE[0:0]", "", true},
    {"25 TXDATA, no encoder on GT11", F::GT11, "TXDATA/IN/64/dw", "", "port TXDATA_IN/32", "",
     true},
    {"25 TXCHARDISPVAL, PCS bypassed on GT11", F::GT11, "TXCHARDISPVAL/IN/8/dw",
     "QVZX_ONLY_BYPASS_PCS=TRUE;QVZX_ONLY_ENCODING=DYNAMIC", "maps 0_0=PRE[0:0]", "", true},
    {"26 RXRUNDISP, no decoder", F::GT10, "RXRUNDISP/OUT/8/dw", "", "maps 0_0=PRE[0:0]", "", true},
    {"26 RXDATA, decoder", F::GT10, "RXDATA/OUT/64/dw", "QVZX_ONLY_DECODING=DYNAMIC",
     "port RXDATA_OUT/32", "", true},
    {"27 TXENC64B66BUSE, no encoder", F::GT10, "TXENC64B66BUSE/OUT", "", "tie 0"},
    {"27 TXGEARBOX64B66BUSE, static 8B/10B", F::GT10, "TXGEARBOX64B66BUSE/OUT",
     "QVZX_ONLY_ENCODING=STATIC", "tie 0"},
    {"27 TXSCRAM64B66BUSE, static 64B/66B", F::GT11, "TXSCRAM64B66BUSE/OUT",
     "QVZX_ONLY_ENCODING=STATIC;QVZX_ONLY_ENC_STATIC=64B66B", "tie 1"},
    {"27 TXENC64B66BUSE, dynamic goes on", F::GT10, "TXENC64B66BUSE/OUT",
     "QVZX_ONLY_ENCODING=DYNAMIC", "port TXENC64B66BUSE_OUT/1"},
    {"27 TXENC64B66BUSE on GT", F::GT, "TXENC64B66BUSE/OUT", "", "port TXENC64B66BUSE_OUT/1"},
    {"28 RXIGNOREBTF, no decoder", F::GT11, "RXIGNOREBTF/OUT", "", "tie 0"},
    {"28 RXDEC64B66BUSE, static 64B/66B", F::GT10, "RXDEC64B66BUSE/OUT",
     "QVZX_ONLY_DECODING=STATIC;QVZX_ONLY_DEC_STATIC=64B66B", "tie 1"},
    {"28 RXBLOCKSYNC64B66BUSE, dynamic goes on", F::GT10, "RXBLOCKSYNC64B66BUSE/OUT",
     "QVZX_ONLY_DECODING=DYNAMIC", "port RXBLOCKSYNC64B66BUSE_OUT/1"},
    {"28 RXDESCRAM64B66BUSE, dynamic, receiver unused", F::GT10, "RXDESCRAM64B66BUSE/OUT",
     "QVZX_ONLY_DECODING=DYNAMIC;QVZ_BOOL_RX_USE=FALSE", "unconnected"},

    {"29 LOOPBACK, receiver unused", F::GT10, "LOOPBACK/OUT/2", "QVZ_BOOL_RX_USE=FALSE",
     "unconnected"},
    {"29 RXRECCLK, receiver unused", F::GT10, "RXRECCLK/OUT", "QVZ_BOOL_RX_USE=FALSE",
     "unconnected"},
    {"29 RXUSRCLK2, receiver unused", F::GT10, "RXUSRCLK2/OUT", "QVZ_BOOL_RX_USE=FALSE",
     "port RXUSRCLK2_OUT/1"},
    {"29/31 RXRECCLK, receiver unused, GT_CUSTOM bypassed", F::GT, "RXRECCLK/OUT",
     "QVZ_BOOL_RX_USE=FALSE;QVZX_ONLY_BYPASS_PCS=TRUE", "port RXRECCLK_OUT/1"},
    {"30 TXOUTCLK, transmitter unused", F::GT10, "TXOUTCLK/OUT", "QVZ_BOOL_TX_USE=FALSE",
     "unconnected"},
    {"30 LOOPBACK, transmitter unused", F::GT11, "LOOPBACK/OUT/2", "QVZ_BOOL_TX_USE=FALSE",
     "unconnected"},
    {"30 TXUSRCLK, transmitter unused", F::GT10, "TXUSRCLK/OUT", "QVZ_BOOL_TX_USE=FALSE",
     "port TXUSRCLK_OUT/1"},
    {"29/30 user clocks, neither direction", F::GT11, "TXUSRCLK2/IN",
     "QVZ_BOOL_RX_USE=FALSE;QVZ_BOOL_TX_USE=FALSE", "port TXUSRCLK2_IN/1"},
    {"31 RXRECCLK, receiver unused, fixed GT primitive", F::GT, "RXRECCLK/OUT",
     "prim=GT_FIBRE_CHAN;QVZ_BOOL_RX_USE=FALSE", "unconnected"},
    {"31 RXRECCLK, receiver unused, GT10 bypassed", F::GT10, "RXRECCLK/OUT",
     "QVZ_BOOL_RX_USE=FALSE;QVZX_ONLY_BYPASS_PCS=TRUE", "unconnected"},
    {"32 TXOUTCLK, transmitter unused, fixed GT primitive", F::GT, "TXOUTCLK/OUT",
     "prim=GT_ETHERNET;QVZ_BOOL_TX_USE=FALSE", "unconnected"},
    {"32 TXOUTCLK, transmitter unused, GT_CUSTOM bypassed", F::GT, "TXOUTCLK/OUT",
     "QVZ_BOOL_TX_USE=FALSE;QVZX_ONLY_BYPASS_PCS=TRUE", "port TXOUTCLK_OUT/1"},
    {"33 RXLOSSOFSYNC on XAUI", F::GT11, "RXLOSSOFSYNC/OUT/2", "display=XAUI", "unconnected"},
    {"33 RXMCLK on XAUI", F::GT11, "RXMCLK/OUT", "display=XAUI", "unconnected"},
    {"33 RXMCLK off XAUI", F::GT11, "RXMCLK/OUT", "display=Custom", "port RXMCLK_OUT/1"},

    {"34 RXDATAWIDTH, 1 byte", F::GT11, "RXDATAWIDTH/IN/2", "QVZ_RX_DATA_WIDTH=1", "tie 0"},
    {"34 TXDATAWIDTH, 2 bytes", F::GT11, "TXDATAWIDTH/IN/2", "QVZ_RX_DATA_WIDTH=2",
     "maps 1_1=GNDa[0:0],0_0=VCCa[0:0]"},
    {"34 RXDATAWIDTH, 4 bytes", F::GT11, "RXDATAWIDTH/IN/2", "",
     "maps 1_1=VCCa[0:0],0_0=GNDa[0:0]"},
    {"34 RXDATAWIDTH, 8 bytes", F::GT11, "RXDATAWIDTH/IN/2", "QVZ_RX_DATA_WIDTH=8", "tie 1"},
    {"34 TXDATAWIDTH of one bit", F::GT11, "TXDATAWIDTH/IN/1", "", "maps 0_0=GNDa[0:0]"},
    {"34 RXDATAWIDTH on GT10", F::GT10, "RXDATAWIDTH/IN/2", "", "port RXDATAWIDTH_IN/2"},
    {"35 TXINTDATAWIDTH, dynamic", F::GT11, "TXINTDATAWIDTH/IN/2", "QVZX_ONLY_ENCODING=DYNAMIC",
     "port TXINTDATAWIDTH_IN/2"},
    {"35 TXINTDATAWIDTH, static 8B/10B", F::GT11, "TXINTDATAWIDTH/IN/2",
     "QVZX_ONLY_ENCODING=STATIC", "tie 1", "", true},
    {"35 TXINTDATAWIDTH, no encoder", F::GT11, "TXINTDATAWIDTH/IN/2", "",
     "maps 0_0=GNDa[0:0],1_1=VCCa[0:0]", "", true},
    {"35 TXINTDATAWIDTH, static 64B/66B", F::GT11, "TXINTDATAWIDTH/IN/2",
     "QVZX_ONLY_ENCODING=STATIC;QVZX_ONLY_ENC_STATIC=64B66B", "maps 0_0=GNDa[0:0],1_1=VCCa[0:0]"},
    {"35 TXINTDATAWIDTH with a tie of its own", F::GT11, "TXINTDATAWIDTH/IN/2", "", "tie 0",
     "QVZ_PIN_TIE=GND"},
    {"36 RXINTDATAWIDTH, dynamic", F::GT11, "RXINTDATAWIDTH/IN/2", "QVZX_ONLY_DECODING=DYNAMIC",
     "port RXINTDATAWIDTH_IN/2"},
    {"36 RXINTDATAWIDTH, static 8B/10B", F::GT11, "RXINTDATAWIDTH/IN/2",
     "QVZX_ONLY_DECODING=STATIC", "tie 1"},
    {"37 any other input", F::GT10, "POWERDOWN/IN", "", "port POWERDOWN_IN/1"},
    {"37 an inout pin is named after itself", F::GT10, "SCANIO/INOUT/3", "", "port SCANIO/3"},

    // The common tail.
    {"comma: ENPCOMMAALIGN always", F::GT10, "ENPCOMMAALIGN/IN", "QVZX_ONLY_PCOMMA_CTRL=ALWAYS",
     "tie 1"},
    {"comma: ENMCOMMAALIGN disabled", F::GT, "ENMCOMMAALIGN/OUT", "QVZX_ONLY_MCOMMA_CTRL=DISABLE",
     "tie 0"},
    {"comma: ENMCOMMAALIGN by the user", F::GT10, "ENMCOMMAALIGN/IN",
     "QVZX_ONLY_MCOMMA_CTRL=USER;QVZX_ONLY_PCOMMA_CTRL=ALWAYS", "port ENMCOMMAALIGN_IN/1"},
    {"comma: not on GT11", F::GT11, "ENPCOMMAALIGN/IN", "QVZX_ONLY_PCOMMA_CTRL=ALWAYS",
     "port ENPCOMMAALIGN_IN/1"},
    {"comma: not on fixed GT primitives", F::GT, "ENPCOMMAALIGN/IN",
     "prim=GT_FIBRE_CHAN;QVZX_ONLY_PCOMMA_CTRL=DISABLE", "port ENPCOMMAALIGN_IN/1"},
    {"comma off: input tied 0", F::GT10, "ENMCOMMAALIGN/IN",
     "QVZX_ONLY_TURNOFF_COMMA=TRUE;QVZX_ONLY_MCOMMA_CTRL=ALWAYS", "tie 0"},
    {"comma off: output unconnected", F::GT10, "RXREALIGN/OUT", "QVZX_ONLY_TURNOFF_COMMA=TRUE",
     "unconnected"},
    {"comma off: other pins keep their ports", F::GT10, "RXRECCLK/OUT",
     "QVZX_ONLY_TURNOFF_COMMA=TRUE", "port RXRECCLK_OUT/1"},
    {"RXCLKCORCNT without correction or bonding", F::GT10, "RXCLKCORCNT/OUT/3",
     "QVZ_CHAN_BOND_NUMBER=0", "unconnected"},
    {"RXCLKCORCNT with clock correction", F::GT10, "RXCLKCORCNT/OUT/3",
     "QVZ_CHAN_BOND_NUMBER=0;CLK_CORRECT_USE=TRUE", "port RXCLKCORCNT_OUT/3"},
    {"port step: a tie of its own", F::GT10, "RXRECCLK/OUT", "", "unconnected", "QVZ_PIN_TIE=1"},
    {"port step: tied 1 in the data file", F::GT10, "RXRECCLK/OUT", "", "unconnected",
     "QVZ_PIN_VCC_IN_DATAFILE=TRUE"},
    {"port step: tied 0 in the data file", F::GT10, "POWERDOWN/IN", "", "tie 0",
     "QVZ_PIN_GND_IN_DATAFILE=TRUE"},
    {"floating input tied 0", F::GT10, "POWERDOWN/IN", "", "tie 0", "QVZ_PIN_TIE=VCC"},
    {"floating input kept by its TRUE tie", F::GT10, "POWERDOWN/IN", "", "unconnected",
     "QVZ_PIN_TIE=TRUE"},
    {"floating input with bit maps", F::GT10, "POWERDOWN/IN/2", "", "maps 0_0=PRE[0:0]",
     "QVZ_PIN_TIE=GND", true},
};

class PinRule : public ::testing::TestWithParam<RuleCase> {};

TEST_P(PinRule, DecidesThePin) {
    const RuleCase& c = GetParam();
    FinishBench bench(c.family, c.settings);
    Qvz_Pin* pin = bench.AddPin(c.pin);
    for (const auto& kv : Pairs(c.pinAttrs))
        pin->SetAttributeValue(kv.first.c_str(), kv.second.c_str());
    bench.Page();
    if (c.preset)
        pin->SetPinSigBitProp("PRE", 0, 0, 0, 0);
    bench.page->FinalizePins();
    EXPECT_EQ(Describe(bench.Data(), pin), c.expect);
    EXPECT_TRUE(pin->IsUsed());
}

INSTANTIATE_TEST_SUITE_P(Finish, PinRule, ::testing::ValuesIn(kRules),
                         [](const ::testing::TestParamInfo<RuleCase>& info) {
                             std::string name = std::to_string(info.index) + "_";
                             for (const char* p = info.param.label; *p; ++p)
                                 name += std::isalnum(static_cast<unsigned char>(*p)) ? *p : '_';
                             return name;
                         });

} // namespace

TEST(Finish, WithoutDataOrActiveBlockChangesNothing) {
    Qvz_MGTWizMain main("w", false);
    Qvz_MGTGeneralSetup noData(&main);
    EXPECT_TRUE(noData.FinalizePins());

    FinishBench bench(F::GT10, "");
    bench.AddPin("POWERDOWN/IN");
    bench.Page();
    bench.block->SetIsUsed(false);
    const Qvz_WizData before = bench.Data();
    EXPECT_TRUE(bench.page->FinalizePins());
    EXPECT_TRUE(bench.Data() == before);
}

TEST(Finish, ReceiverUnusedTakesTheBondingNumberToZero) {
    FinishBench bench(F::GT10, "QVZ_BOOL_RX_USE=FALSE;QVZ_CHAN_BOND_NUMBER=4");
    bench.AddPin("CHBONDO/OUT/5");
    EXPECT_TRUE(bench.Page().FinalizePins());
    EXPECT_EQ(bench.block->GetAttributeValue("QVZ_CHAN_BOND_NUMBER"), "0");
    EXPECT_TRUE(bench.design->Messages().empty());
}

TEST(Finish, ChannelBondOutUsesTheMastersChainWhenThereIsOne) {
    FinishBench bench(F::GT10, "QVZ_CHAN_BOND_NUMBER=2");
    bench.AddPin("CHBONDO/OUT/5");
    Qvz_Signal* chain = bench.Data().AddSignal("CHANBOND_M_S1", true, "O");
    chain->SetIsUsed(false);
    bench.Page().FinalizePins();
    EXPECT_EQ(bench.Of("CHBONDO"), "wire CHANBOND_M_S1/5");
    EXPECT_TRUE(chain->IsUsed());
    EXPECT_TRUE(chain->IsBus());
    EXPECT_EQ(bench.Data().GetNamedSignal("CHANBOND_M_S1_OUT"), nullptr);
}

TEST(Finish, BondedCopiesNeedTheChannelBondingPage) {
    const char* const kNoPage = "Internal Error:  Qvz_MGTRCB page pointer is null\n";
    const struct {
        F family;
        const char* settings;
        bool due;
    } cases[] = {
        {F::GT10, "QVZ_CHAN_BOND_NUMBER=2", true}, {F::GT10, "QVZ_CHAN_BOND_NUMBER=1", false},
        {F::GT, "QVZ_CHAN_BOND_NUMBER=0", false},  {F::GT11, "QVZ_CHAN_BOND_NUMBER=1", true},
        {F::GT11, "QVZ_BOOL_RX_USE=FALSE", true},
    };
    for (const auto& c : cases) {
        FinishBench bench(c.family, c.settings);
        bench.AddPin("POWERDOWN/IN");
        // The bench's main has no pages at all.
        EXPECT_EQ(bench.Page().FinalizePins(), !c.due) << c.settings;
        const auto messages = bench.design->Messages();
        EXPECT_EQ(messages, c.due ? std::vector<std::string>{kNoPage} : std::vector<std::string>{})
            << c.settings;
        if (c.due) {
            ASSERT_EQ(bench.design->main.GetMessages().size(), 1u);
            const Qvz_Message& m = bench.design->main.GetMessages()[0];
            EXPECT_FALSE(m.flag1 || m.flag2 || m.flag3);
        }
        // Everything else is decided all the same.
        EXPECT_EQ(bench.Of("POWERDOWN"), "port POWERDOWN_IN/1") << c.settings;
    }
}

TEST(Finish, Gt11AddsTheTileBusPinsOnce) {
    FinishBench bench(F::GT11, "");
    bench.AddPin("POWERDOWN/IN");
    bench.Page().FinalizePins();
    bench.page->FinalizePins();
    const auto& pins = bench.block->GetPins();
    ASSERT_EQ(pins.size(), 3u);
    EXPECT_EQ(pins[1]->GetName(), "COMBUSIN");
    EXPECT_EQ(pins[1]->GetDirection(), "IN");
    EXPECT_EQ(pins[1]->GetWidth(), 16);
    EXPECT_EQ(pins[2]->GetName(), "COMBUSOUT");
    EXPECT_EQ(pins[2]->GetDirection(), "OUT");
    EXPECT_EQ(pins[2]->GetWidth(), 16);
    // Left for the bonding step to wire: not grounded as a floating input.
    EXPECT_EQ(bench.Of("COMBUSIN"), "unconnected");
    EXPECT_EQ(bench.Of("COMBUSOUT"), "unconnected");
}

TEST(Finish, ATieReplacesTheOtherConnections) {
    FinishBench bench(F::GT10, "QVZX_ONLY_REFCLK_DYN=STATIC;QVZX_ONLY_REFCLK=REFCLK2");
    Qvz_Pin* sel = bench.AddPin("REFCLKSEL/IN");
    Qvz_Pin* pd = bench.AddPin("POWERDOWN/IN");
    bench.Page();
    // Left over from an earlier run of the host on this design.
    sel->SetIsGrounded(true);
    sel->SetSigName("REFCLKSEL_IN");
    pd->SetIsVcc(true);
    bench.page->FinalizePins();
    EXPECT_EQ(bench.Of("REFCLKSEL"), "tie 1");
    // A port is not tied as well.
    EXPECT_EQ(bench.Of("POWERDOWN"), "port POWERDOWN_IN/1");
}

// MakePinPort ----------------------------------------------------------------

TEST(MakePinPort, WidthFollowsTheDataWidth) {
    const struct {
        const char* pin;
        int dataWidth;
        const char* expect;
        bool bus;
        const char* onlyBits; // BUS_ONLY_USE_BITS, "" when absent
    } cases[] = {
        {"TXDATA/IN/64/dw", 2, "port TXDATA_IN/16", true, "16"},
        {"RXDATA/OUT/16/dw", 2, "port RXDATA_OUT/16", true, ""},
        {"RXCHARISK/OUT/8/dw", 2, "port RXCHARISK_OUT/2", true, "2"},
        {"TXKERR/IN/1/dw", 1, "port TXKERR_IN/1", true, ""},
        {"LOOPBACK/IN/2", 4, "port LOOPBACK_IN/2", true, ""},
        {"POWERDOWN/IN", 4, "port POWERDOWN_IN/1", false, ""},
        // A width that is no usable data width: the pin's own width.
        {"TXDATA/IN/64/dw", 0, "port TXDATA_IN/64", true, ""},
        {"RXCHARISK/OUT/8/dw", -3, "port RXCHARISK_OUT/8", true, ""},
        // An absurd one: the widest the transceivers have.
        {"TXDATA/IN/64/dw", INT_MAX, "port TXDATA_IN/64", true, ""},
        {"TXCHARISK/IN/8/dw", INT_MAX, "port TXCHARISK_IN/8", true, ""},
    };
    for (const auto& c : cases) {
        FinishBench bench(F::GT10, "");
        Qvz_Pin* pin = bench.AddPin(c.pin);
        bench.Page().MakePinPort(pin, c.dataWidth);
        EXPECT_EQ(Describe(bench.Data(), pin), c.expect) << c.pin << " " << c.dataWidth;
        const Qvz_Signal* s = bench.Data().GetNamedSignal(pin->GetSigName());
        ASSERT_NE(s, nullptr);
        EXPECT_EQ(s->IsBus(), c.bus) << c.pin;
        EXPECT_TRUE(s->IsExternal() && s->IsUsed());
        EXPECT_EQ(s->GetAttributeValue("BUS_ONLY_USE_BITS"), c.onlyBits) << c.pin;
    }
}

TEST(MakePinPort, FindsOrNamesTheSignal) {
    FinishBench bench(F::GT10, "");
    Qvz_Pin* txdata = bench.AddPin("TXDATA/IN/32/dw");
    Qvz_Pin* rxdata = bench.AddPin("RXDATA/OUT/32/dw");
    Qvz_Pin* clk = bench.AddPin("RXUSRCLK/IN");
    Qvz_Pin* named = bench.AddPin("TXUSRCLK/IN");
    bench.Page();
    Qvz_WizData& d = bench.Data();
    // A signal named like the pin is taken as it is.
    Qvz_Signal* rxSig = d.AddSignal("RXDATA", true, "O");
    rxSig->SetIsUsed(false);
    rxSig->SetAttributeValue("BUS_ONLY_USE_BITS", "8");
    rxdata->SetPinSigBitProp("RXDATA_OUT", 7, 0, 17, 10);
    // A data pin on some other signal starts afresh.
    txdata->SetSigName("OTHER");
    txdata->SetPinSigBitProp("TXDATA_IN", 7, 0, 7, 0);
    // Any other pin keeps the signal it names.
    named->SetSigName("USERCLK");
    for (Qvz_Pin* p : {txdata, rxdata, clk, named})
        bench.page->MakePinPort(p, 4);
    EXPECT_EQ(bench.Of("TXDATA"), "port TXDATA_IN/32");
    EXPECT_EQ(bench.Of("RXDATA"), "port RXDATA/32");
    EXPECT_TRUE(rxSig->IsUsed());
    EXPECT_EQ(rxSig->GetAttributeValue("BUS_ONLY_USE_BITS"), "");
    EXPECT_EQ(bench.Of("RXUSRCLK"), "port RXUSRCLK_IN/1");
    EXPECT_EQ(bench.Of("TXUSRCLK"), "port USERCLK/1");
    EXPECT_EQ(d.GetNamedSignal("USERCLK")->GetDirection(), "I");
    EXPECT_EQ(d.GetNamedSignal("OTHER"), nullptr);
}

TEST(MakePinPort, Gt11TakesTheLibraryWidth) {
    FinishBench bench(F::GT11, "display=XAUI");
    Qvz_Pin* txdata = bench.AddPin("TXDATA/IN/64/dw");
    Qvz_Pin* kerr = bench.AddPin("TXKERR/IN/8/dw");
    // The "Custom" library block says how wide the pins are.
    Qvz_Block* custom =
        bench.design->Block("LIB", "GT11_CUSTOM", "Custom", "QVZ_RX_DATA_WIDTH", "4");
    Pin(custom, "TXDATA", 32, true);
    Pin(custom, "TXKERR", 4, true);
    bench.Page().MakePinPort(txdata, 2);
    bench.page->MakePinPort(kerr, 4);
    EXPECT_EQ(txdata->GetWidth(), 32);
    EXPECT_EQ(bench.Of("TXDATA"), "port TXDATA_IN/16");
    EXPECT_EQ(bench.Data().GetNamedSignal("TXDATA_IN")->GetAttributeValue("BUS_ONLY_USE_BITS"),
              "16");
    EXPECT_EQ(kerr->GetWidth(), 4);
    EXPECT_EQ(bench.Of("TXKERR"), "port TXKERR_IN/4");
    EXPECT_FALSE(bench.Data().GetNamedSignal("TXKERR_IN")->HasAttribute("BUS_ONLY_USE_BITS"));

    // RestorePinWidth leaves other families and plain pins alone.
    Qvz_Pin* plain = bench.AddPin("LOOPBACK/IN/2");
    Pin(custom, "LOOPBACK", 8);
    bench.page->RestorePinWidth(plain);
    EXPECT_EQ(plain->GetWidth(), 2);
}

// The 10-bit buses -----------------------------------------------------------

namespace {

std::string SignalOf(const Qvz_WizData& d, const char* name) {
    const Qvz_Signal* s = d.GetNamedSignal(name);
    if (!s)
        return "none";
    QStringList flags;
    if (s->IsBus())
        flags << "bus";
    if (s->IsExternal())
        flags << "ext " + s->GetDirection().ToQString();
    if (s->IsConst0())
        flags << "const0";
    if (s->IsConst1())
        flags << "const1";
    if (s->IsUsed())
        flags << "used";
    return QString("%1 %2").arg(s->GetWidth()).arg(flags.join(' ')).toStdString();
}

} // namespace

TEST(TenBitBus, TxGathersTenBitsPerByte) {
    FinishBench bench(F::GT, "TX_DATA_WIDTH=2");
    bench.AddPin("TXDATA/IN/32/dw");
    bench.AddPin("TXCHARDISPVAL/IN/4/dw");
    bench.AddPin("TXCHARDISPMODE/IN/4/dw");
    bench.Page();
    for (const char* left : {"TXCHARDISPVAL_IN", "TXCHARDISPMODE"})
        bench.Data().AddSignal(left, true, "I");
    bench.page->BuildTxTenBitBus(bench.block);
    EXPECT_EQ(bench.Of("TXDATA"), "maps 7_0=TXDATA_IN[7:0],15_8=TXDATA_IN[17:10],"
                                  "31_16=TXDATA_GND[15:0]");
    EXPECT_EQ(bench.Of("TXCHARDISPVAL"), "maps 0_0=TXDATA_IN[8:8],1_1=TXDATA_IN[18:18],"
                                         "3_2=TXCHARDISPVAL_GND[1:0]");
    EXPECT_EQ(bench.Of("TXCHARDISPMODE"), "maps 0_0=TXDATA_IN[9:9],1_1=TXDATA_IN[19:19],"
                                          "3_2=TXCHARDISPMODE_GND[1:0]");
    const Qvz_WizData& d = bench.Data();
    EXPECT_EQ(SignalOf(d, "TXDATA_IN"), "20 bus ext I used");
    EXPECT_EQ(SignalOf(d, "TXDATA_GND"), "16 bus const0 used");
    EXPECT_EQ(SignalOf(d, "TXCHARDISPVAL_GND"), "2 bus const0 used");
    EXPECT_EQ(SignalOf(d, "TXCHARDISPVAL_IN"), "1 ext I");
    EXPECT_EQ(SignalOf(d, "TXCHARDISPMODE"), "1 ext I");
}

TEST(TenBitBus, RxUsesAnExistingBusAndFloatsSpareBits) {
    FinishBench bench(F::GT10, "QVZ_RX_DATA_WIDTH=1");
    bench.AddPin("RXDATA/OUT/9/dw");
    bench.AddPin("RXRUNDISP/OUT/2/dw");
    bench.AddPin("RXCHARISK/OUT/1/dw");
    bench.Page();
    Qvz_Signal* bus = bench.Data().AddSignal("RXDATA", true, "O");
    bus->SetAttributeValue("BUS_ONLY_USE_BITS", "8");
    bench.page->BuildRxTenBitBus(bench.block);
    EXPECT_EQ(bench.Of("RXDATA"), "maps 7_0=RXDATA[7:0],8_8=RXDATA_float[0:0]");
    EXPECT_EQ(bench.Of("RXRUNDISP"), "maps 0_0=RXDATA[8:8],1_1=RXRUNDISP_float[0:0]");
    EXPECT_EQ(bench.Of("RXCHARISK"), "maps 0_0=RXDATA[9:9]");
    const Qvz_WizData& d = bench.Data();
    EXPECT_EQ(SignalOf(d, "RXDATA"), "10 bus ext O used");
    EXPECT_FALSE(bus->HasAttribute("BUS_ONLY_USE_BITS"));
    EXPECT_EQ(d.GetNamedSignal("RXDATA_OUT"), nullptr);
    // The data pin's spare signal is a bus even of one bit; the others not.
    EXPECT_EQ(SignalOf(d, "RXDATA_float"), "1 bus used");
    EXPECT_EQ(SignalOf(d, "RXRUNDISP_float"), "1 used");
    EXPECT_EQ(SignalOf(d, "RXCHARISK_float"), "none");
}

TEST(TenBitBus, NarrowPinsMapOnlyTheBitsTheyHave) {
    FinishBench bench(F::GT10, "QVZ_TX_DATA_WIDTH=2");
    bench.AddPin("TXDATA/IN/12/dw");
    bench.AddPin("TXCHARDISPVAL/IN/1/dw");
    bench.AddPin("TXCHARDISPMODE/IN/2/dw");
    bench.Page().BuildTxTenBitBus(bench.block);
    EXPECT_EQ(bench.Of("TXDATA"), "maps 7_0=TXDATA_IN[7:0],11_8=TXDATA_IN[13:10]");
    EXPECT_EQ(bench.Of("TXCHARDISPVAL"), "maps 0_0=TXDATA_IN[8:8]");
    EXPECT_EQ(bench.Of("TXCHARDISPMODE"), "maps 0_0=TXDATA_IN[9:9],1_1=TXDATA_IN[19:19]");
    EXPECT_EQ(SignalOf(bench.Data(), "TXDATA_IN"), "20 bus ext I used");
    for (const char* spare : {"TXDATA_GND", "TXCHARDISPVAL_GND", "TXCHARDISPMODE_GND"})
        EXPECT_EQ(SignalOf(bench.Data(), spare), "none") << spare;
}

TEST(TenBitBus, NothingWithoutAllPinsOrAWidth) {
    const struct {
        const char* settings;
        bool all;
    } cases[] = {
        {"QVZ_TX_DATA_WIDTH=2", false}, {"QVZ_TX_DATA_WIDTH=", true},
        {"QVZ_TX_DATA_WIDTH=0", true},  {"QVZ_TX_DATA_WIDTH=-2", true},
        {"QVZ_TX_DATA_WIDTH=x", true},
    };
    for (const auto& c : cases) {
        FinishBench bench(F::GT10, c.settings);
        bench.AddPin("TXDATA/IN/32/dw");
        bench.AddPin("TXCHARDISPVAL/IN/4/dw");
        if (c.all)
            bench.AddPin("TXCHARDISPMODE/IN/4/dw");
        bench.Page();
        bench.block->GetNamedPin("TXDATA")->SetPinSigBitProp("PRE", 0, 0, 0, 0);
        const Qvz_WizData before = bench.Data();
        bench.page->BuildTxTenBitBus(bench.block);
        EXPECT_TRUE(bench.Data() == before) << c.settings;
    }
}

TEST(TenBitBus, AbsurdWidthIsBounded) {
    FinishBench bench(F::GT10, "QVZ_TX_DATA_WIDTH=99999999999");
    bench.AddPin("TXDATA/IN/64/dw");
    bench.AddPin("TXCHARDISPVAL/IN/8/dw");
    bench.AddPin("TXCHARDISPMODE/IN/8/dw");
    bench.Page().BuildTxTenBitBus(bench.block);
    EXPECT_EQ(SignalOf(bench.Data(), "TXDATA_IN"), "80 bus ext I used");
    EXPECT_EQ(SignalOf(bench.Data(), "TXDATA_GND"), "none");
}

TEST(GroundFloatingInputs, TiesOnlyInputsConnectedToNothing) {
    FinishBench bench(F::GT10, "");
    bench.Page();
    const struct {
        const char* pin;
        const char* attrs;
        const char* signal;
        bool map;
        const char* expect;
    } cases[] = {
        {"A/IN", "", "", false, "tie 0"},
        {"B/OUT", "", "", false, "unconnected"},
        {"C/INOUT", "", "", false, "unconnected"},
        {"D/IN", "QVZ_PIN_TIE=TRUE", "", false, "unconnected"},
        {"E/IN", "QVZ_PIN_TIE=0", "", false, "tie 0"},
        {"F/IN", "", "F_IN", false, "dangling F_IN"},
        {"G/IN", "", "", true, "maps 0_0=PRE[0:0]"},
    };
    for (const auto& c : cases) {
        Qvz_Pin* p = bench.AddPin(c.pin);
        for (const auto& kv : Pairs(c.attrs))
            p->SetAttributeValue(kv.first.c_str(), kv.second.c_str());
        p->SetSigName(c.signal);
        if (c.map)
            p->SetPinSigBitProp("PRE", 0, 0, 0, 0);
    }
    Qvz_Pin* vcc = bench.AddPin("H/IN");
    vcc->SetIsVcc(true);
    bench.page->GroundFloatingInputs(bench.block);
    for (const auto& c : cases) {
        const std::string name = QString(c.pin).section('/', 0, 0).toStdString();
        EXPECT_EQ(bench.Of(name.c_str()), c.expect) << c.pin;
    }
    EXPECT_EQ(bench.Of("H"), "tie 1");
}

TEST(FinishSummary, TellsEveryOutcomeOfThePins) {
    FinishBench bench(F::GT10, "QVZ_CHAN_BOND_NUMBER=2;QVZ_TX_DATA_WIDTH=2");
    for (const char* pin : {"REFCLK/IN", "CONFIGIN/IN", "CONFIGOUT/OUT", "CHBONDO/OUT/5",
                            "TXDATA/IN/32/dw", "TXCHARDISPVAL/IN/4/dw", "TXCHARDISPMODE/IN/4/dw"})
        bench.AddPin(pin);
    bench.Page().FinalizePins();
    const Qvz_Summary s = Qvz_Summary::Of(bench.Data());
    ASSERT_EQ(s.ports.size(), 1u);
    EXPECT_EQ(s.ports[0].signal, "REFCLK_IN");
    ASSERT_EQ(s.ties.size(), 1u);
    EXPECT_EQ(s.ties[0].pin, "CONFIGIN");
    EXPECT_EQ(s.unconnected, std::vector<QString>{"CONFIGOUT"});
    ASSERT_EQ(s.wired.size(), 1u);
    EXPECT_EQ(s.wired[0].pin, "CHBONDO");
    EXPECT_EQ(s.wired[0].signal, "CHANBOND_M_S1_OUT");
    EXPECT_EQ(s.bitMapped.size(), 3u);

    const QString text = s.ToText(false);
    for (const char* line :
         {"Tied pins:     1", "Internal pins: 1", "  CHBONDO -> CHANBOND_M_S1_OUT",
          "Unconnected:   1", "  CONFIGOUT", "Bit-wise:      TXDATA"})
        EXPECT_TRUE(text.contains(line)) << line << "\n" << text.toStdString();
    // The command line's short form keeps the counts.
    EXPECT_TRUE(s.ToText(true).contains("Unconnected:   1"));
    EXPECT_FALSE(s.ToText(true).contains("  CONFIGOUT"));
    const QString html = s.ToHtml(true);
    for (const char* part :
         {"Unconnected pins (1)", "CONFIGOUT", "Pins on internal signals (1)", "CHANBOND_M_S1_OUT"})
        EXPECT_TRUE(html.contains(part)) << part;
}
