#!/usr/bin/env python3
"""Writes the embedded sample targets (data/targets/) and the worked examples
(examples/) of velomux-wizard.

Each target is the library of one transceiver family: one block per primitive
the device offers, each carrying every attribute the wizard pages read for
that family (value, default, editable flag, legal values) and every pin the
finish routine decides. The examples are the same libraries with a different
active block and a few saved settings.

Run from anywhere: python3 scripts/make-targets.py
The output is committed; rerun it after changing this file.
"""

import json
import os
import sys

ROOT = os.path.dirname(os.path.dirname(os.path.abspath(__file__)))

TF = ["TRUE", "FALSE"]

# The largest number of transceivers of a family that the sample devices bond.
MAX_BOND = {"GT": 20, "GT10": 20, "GT11": 24}


# --------------------------------------------------------------------------
# 11-bit sequence characters: a control flag, then the byte. Two leading
# zeros fill the eleven digits that the clock-correction and channel-bonding
# sequence attributes hold.
def k(byte):
    return "001" + format(byte, "08b")


def d(byte):
    return "000" + format(byte, "08b")


K28_0, K28_3, K28_5, K23_7 = k(0x1C), k(0x7C), k(0xBC), k(0xF7)
D21_4, D21_5, D16_2, D10_2 = d(0x95), d(0xB5), d(0x50), d(0x4A)
IDLE_64B = k(0x07)  # the idle control character of the 64B/66B protocols
ZERO11 = "0" * 11


def seq4(*chars):
    chars = list(chars)
    return chars + [ZERO11] * (4 - len(chars))


def mask_for(length):
    # one "0" (compare) per sequence character, "1" (ignore) for the rest
    n = min(int(length), 4)
    return "0" * n + "1" * (4 - n)


def bond_numbers(family):
    step = 2 if family == "GT11" else 1  # GT11 bonds whole tiles
    return ["0"] + [str(n) for n in range(2, MAX_BOND[family] + 1, step)]


# --------------------------------------------------------------------------
class Block:
    def __init__(self, name, primitive):
        self.name = name
        self.primitive = primitive
        self.used = False
        self.attrs = []  # dicts, in order
        self.pins = []

    def attr(self, name, value, legal=None, editable=True, default=None):
        for a in self.attrs:
            if a["name"] == name:
                raise ValueError("duplicate attribute %s on %s" % (name, self.name))
        a = {"name": name, "value": value}
        if default is not None and default != value:
            a["default"] = default
        if not editable:
            a["editable"] = False
        if legal:
            a["legal"] = list(legal)
        self.attrs.append(a)

    def get(self, name):
        for a in self.attrs:
            if a["name"] == name:
                return a
        return None

    def set(self, name, value):
        """A saved setting of an example: the value changes, the default stays."""
        a = self.get(name)
        if a is None:
            raise KeyError(name)
        if "default" not in a:
            a["default"] = a["value"]
        a["value"] = value
        if a["default"] == value:
            del a["default"]
        else:
            a["changed"] = True

    def pin(self, name, direction, width=1, data_width=False):
        for p in self.pins:
            if p["name"] == name:
                raise ValueError("duplicate pin %s on %s" % (name, self.name))
        p = {"name": name, "direction": direction}
        if width != 1:
            p["width"] = width
        if data_width:
            p["data_width"] = True
        self.pins.append(p)

    def to_json(self):
        out = {"name": self.name, "primitive": self.primitive}
        if self.used:
            out["used"] = True
        out["attributes"] = self.attrs
        out["pins"] = self.pins
        return out


# --------------------------------------------------------------------------
# Per-type settings. "fixed" types are protocols: the settings the protocol
# prescribes are not editable.
class Type:
    def __init__(self, display, primitive, widths, single=False, fixed=True,
                 enc="8B10B", cc_len="4", cc=None, cb_len="1", cb=None,
                 crc_format="USER_MODE", sop="K28_2", eop="K29_7",
                 bond="0", bond_fixed=False, speeds=None):
        self.display = display
        self.primitive = primitive  # with "%s" for the width when per width
        self.widths = widths
        self.single = single  # one block serves every width
        self.fixed = fixed
        self.enc = enc  # "8B10B", "64B66B" or "NONE"
        self.cc_len, self.cc = cc_len, cc or seq4(K28_5)
        self.cb_len, self.cb = cb_len, cb or seq4(K28_3)
        self.crc_format, self.sop, self.eop = crc_format, sop, eop
        self.bond, self.bond_fixed = bond, bond_fixed
        self.speeds = speeds  # GT10: PMA speed classes the type runs at

    def prim(self, width):
        return self.primitive % width if "%s" in self.primitive else self.primitive


# --------------------------------------------------------------------------
# GT10 PMA speeds: "<rate index>_<data path bits>". Each class allows some
# encodings; each data width offers some rates.
SPEED_CLASSES = {
    "A": {"NONE", "8B10B", "64B66B"},  # low line rates
    "B": {"NONE", "8B10B"},
    "C": {"NONE", "64B66B"},  # 10 Gb/s class
    "D": {"64B66B"},  # highest rates: scrambled 64B/66B only
}
SPEEDS = {
    "1": [("0_8", "A"), ("1_8", "A"), ("2_8", "B")],
    "2": [("0_16", "A"), ("1_16", "A"), ("2_16", "B"), ("3_16", "C")],
    "4": [("0_32", "A"), ("1_32", "A"), ("2_32", "B"), ("3_32", "B"), ("4_32", "C"),
          ("5_32", "D")],
    "8": [("0_64", "A"), ("1_64", "B"), ("2_64", "C"), ("3_64", "C"), ("4_64", "D")],
}


def speeds_for(t, width):
    return [s for s, c in SPEEDS[width] if c in t.speeds]


def speed_class(speed):
    for width_list in SPEEDS.values():
        for s, c in width_list:
            if s == speed:
                return c
    raise KeyError(speed)


# --------------------------------------------------------------------------
def general_common(b, t, family, width):
    b.attr("MGT_DISPLAY_NAME", t.display, editable=False)
    widths = t.widths
    if family == "GT":
        b.attr("RX_DATA_WIDTH", width, widths)
        b.attr("TX_DATA_WIDTH", width, widths)
    else:
        b.attr("QVZ_RX_DATA_WIDTH", width, widths)
        b.attr("QVZ_TX_DATA_WIDTH", width, widths)
    b.attr("QVZ_BOOL_TX_USE", "TRUE", TF)
    b.attr("QVZ_BOOL_RX_USE", "TRUE", TF)


def encoding_attrs(b, t, family):
    ed = not t.fixed
    if t.enc == "NONE":
        mode, static = "DISABLE", "8B10B"
    else:
        mode, static = "STATIC", t.enc
    statics = ["8B10B"] if family == "GT" else ["8B10B", "64B66B"]
    return mode, static, statics, ed


def transmitter(b, t, family):
    mode, static, statics, ed = encoding_attrs(b, t, family)
    if family == "GT":
        b.attr("TX_PREEMPHASIS", "0", ["0..3"])
        b.attr("TX_DIFF_CTRL", "500", ["400", "500", "600", "700", "800"])
    if family in ("GT", "GT10"):
        # GT10 libraries still list the first family's CRC attributes; the
        # General Setup write removes them.
        b.attr("TX_CRC_USE", "FALSE", TF)
        b.attr("CRC_FORMAT", t.crc_format, ["USER_MODE", "ETHERNET", "INFINIBAND", "FIBRE_CHAN"],
               editable=ed)
        if b.primitive != "GT_FIBRE_CHAN":
            b.attr("CRC_START_OF_PKT", t.sop,
                   ["K28_0", "K28_1", "K28_2", "K28_3", "K28_4", "K28_5", "K28_6", "K28_7",
                    "K23_7", "K27_7", "K30_7"], editable=ed)
            b.attr("CRC_END_OF_PKT", t.eop,
                   ["K28_0", "K28_1", "K28_2", "K28_3", "K28_4", "K28_5", "K28_6", "K28_7",
                    "K23_7", "K27_7", "K29_7", "K30_7"], editable=ed)
        b.attr("TX_CRC_FORCE_VALUE", "11010110")
    if family == "GT11":
        b.attr("QVZ_TXCRC_USE", "FALSE", TF)
        b.attr("QVZ_TXCRC_DATAWIDTH", str(8 * int(b.crc_bytes)), CRC_WIDTHS)
        b.attr("TXCRCCLOCKDOUBLE", "FALSE", TF)
        b.attr("TXCRCINITVAL", "32'hFFFFFFFF")
    b.attr("TX_BUFFER_USE", "TRUE", TF)
    b.attr("QVZX_ONLY_ENCODING", mode, ["DISABLE", "DYNAMIC", "STATIC"], editable=ed)
    b.attr("QVZX_ONLY_ENC_STATIC", static, statics, editable=ed and family != "GT")
    if family == "GT11":
        b.attr("TXPRE_TAP_PD", "TRUE", TF)
        b.attr("TXPOST_TAP_PD", "TRUE", TF)
        b.attr("TXPRE_TAP_DAC", "5'b00000")
        b.attr("TXDAT_TAP_DAC", "5'b10110")
        b.attr("TXPOST_TAP_DAC", "5'b01110")


CRC_WIDTHS = [str(n) for n in range(8, 65, 8)]


def comma(b, t, family):
    ed = not t.fixed
    off = t.enc == "64B66B"  # no commas in a 64B/66B stream
    b.attr("QVZX_ONLY_TURNOFF_COMMA", "TRUE" if off else "FALSE", TF, editable=ed)
    b.attr("DEC_PCOMMA_DETECT", "FALSE" if off else "TRUE", TF, editable=ed)
    b.attr("DEC_MCOMMA_DETECT", "FALSE" if off else "TRUE", TF, editable=ed)
    # GT10 libraries carry it too; the GT10 write removes it
    b.attr("ALIGN_COMMA_MSB", "FALSE", TF, editable=ed)
    b.attr("DEC_VALID_COMMA_ONLY", "TRUE", TF, editable=ed)
    if family == "GT11":
        b.attr("PCOMMA_10B_VALUE", "10'h17C", editable=ed)
        b.attr("PCOMMA_32B_VALUE", "32'h0000017C", editable=ed)
        b.attr("MCOMMA_10B_VALUE", "10'h283", editable=ed)
        b.attr("MCOMMA_32B_VALUE", "32'h00000283", editable=ed)
    else:
        b.attr("PCOMMA_10B_VALUE", "0011111000", editable=ed)
        b.attr("MCOMMA_10B_VALUE", "1100000000", editable=ed)
    ctrl = "DISABLE" if off else "ALWAYS"
    b.attr("PCOMMA_DETECT", "FALSE" if off else "TRUE", TF, editable=ed)
    b.attr("MCOMMA_DETECT", "FALSE" if off else "TRUE", TF, editable=ed)
    b.attr("QVZX_ONLY_PCOMMA_CTRL", ctrl, ["DYNAMIC", "ALWAYS", "DISABLE"], editable=ed)
    b.attr("QVZX_ONLY_MCOMMA_CTRL", ctrl, ["DYNAMIC", "ALWAYS", "DISABLE"], editable=ed)
    if family == "GT11":
        b.attr("COMMA_10B_MASK", "10'h07F", editable=ed)
        b.attr("COMMA_32B_MASK", "32'h0000007F", editable=ed)  # removed by the GT11 write
    else:
        b.attr("COMMA_10B_MASK", "0000000000" if off else "1111111000", editable=ed)
    words = ["1", "2"] if family == "GT" else ["1", "2", "4"]
    b.attr("ALIGN_COMMA_WORD", "1", words, editable=ed)


def receiver(b, t, family):
    mode, static, statics, ed = encoding_attrs(b, t, family)
    # GT11 libraries list the loss-of-sync counters; the GT11 write removes them
    b.attr("RX_LOS_INVALID_INCR", "1", [str(1 << i) for i in range(8)])
    b.attr("RX_LOS_THRESHOLD", "4", [str(4 << i) for i in range(8)])
    b.attr("RX_LOSS_OF_SYNC_FSM", "TRUE", TF)
    if family == "GT":
        b.attr("RX_DECODE_USE", "TRUE", TF, editable=ed)
    b.attr("QVZX_ONLY_DECODING", mode, ["DISABLE", "DYNAMIC", "STATIC"], editable=ed)
    b.attr("QVZX_ONLY_DEC_STATIC", static, statics, editable=ed and family != "GT")
    if family in ("GT", "GT10"):
        b.attr("RX_CRC_USE", "FALSE", TF)
    if family == "GT11":
        b.attr("QVZ_RXCRC_USE", "FALSE", TF)
        b.attr("QVZ_RXCRC_DATAWIDTH", str(8 * int(b.crc_bytes)), CRC_WIDTHS)
        b.attr("RXCRCCLOCKDOUBLE", "FALSE", TF)
        b.attr("RXCRCINITVAL", "32'hFFFFFFFF")
        b.attr("RXAFEEQ", "9'b000000000")
    if family in ("GT10", "GT11"):
        b.attr("SH_CNT_MAX", "64", ["1..255"])
        b.attr("SH_INVALID_CNT_MAX", "16", ["1..255"])
    b.attr("RX_BUFFER_USE", "TRUE", TF)


def clock_correction(b, t, family):
    ed = not t.fixed
    lens = ["1", "2", "4"] if family == "GT" else ["1", "2", "4", "8"]
    b.attr("CLK_CORRECT_USE", "TRUE", TF)
    if family in ("GT", "GT10"):
        b.attr("CLK_COR_KEEP_IDLE", "FALSE", TF)
        b.attr("CLK_COR_INSERT_IDLE_FLAG", "FALSE", TF)
        b.attr("CLK_COR_REPEAT_WAIT", "1", ["0..31"])
    b.attr("CLK_COR_SEQ_LEN", t.cc_len, lens, editable=ed)
    b.attr("CLK_COR_SEQ_2_USE", "FALSE", TF, editable=ed)
    lit = (lambda digits: "%d'b%s" % (len(digits), digits)) if family == "GT11" else (lambda x: x)
    for i, v in enumerate(t.cc):
        b.attr("CLK_COR_SEQ_1_%d" % (i + 1), lit(v), editable=ed)
    for i in range(4):
        b.attr("CLK_COR_SEQ_2_%d" % (i + 1), lit(ZERO11), editable=ed)
    if family != "GT":
        b.attr("CLK_COR_SEQ_1_MASK", lit(mask_for(t.cc_len)), editable=ed)
        b.attr("CLK_COR_SEQ_2_MASK", lit("1111"), editable=ed)
        b.attr("CLK_COR_MIN_LAT", "28", ["3..48"])
        b.attr("CLK_COR_MAX_LAT", "36", ["3..48"])
        b.attr("CLK_COR_SEQ_DROP", "FALSE", TF)
        b.attr("CLK_COR_8B10B_DE", "FALSE" if t.enc != "8B10B" else "TRUE", TF)


def channel_bonding(b, t, family):
    ed = not t.fixed
    lens = ["1", "2", "4"] if family == "GT" else ["1", "2", "4", "8"]
    modes = ["NONE" if family == "GT11" else "OFF", "MASTER", "SLAVE_1_HOP", "SLAVE_2_HOPS"]
    b.attr("QVZ_CHAN_BOND_NUMBER", t.bond, bond_numbers(family), editable=not t.bond_fixed)
    b.attr("QVZ_CHAN_BOND_PRIMARY_ROW", "1", ["0", "1"])
    b.attr("CHAN_BOND_MODE", modes[0], modes)
    b.attr("CHAN_BOND_ONE_SHOT", "FALSE", TF)
    b.attr("CHAN_BOND_LIMIT", "16", ["1..31"])
    if family in ("GT", "GT10"):
        # GT10 libraries carry them too; the GT10 write removes them
        b.attr("CHAN_BOND_OFFSET", "8", ["0..15"])
        b.attr("CHAN_BOND_WAIT", "8", ["1..15"])
    b.attr("CHAN_BOND_SEQ_LEN", t.cb_len, lens, editable=ed)
    b.attr("CHAN_BOND_SEQ_2_USE", "FALSE", TF, editable=ed)
    lit = (lambda digits: "%d'b%s" % (len(digits), digits)) if family == "GT11" else (lambda x: x)
    for i, v in enumerate(t.cb):
        b.attr("CHAN_BOND_SEQ_1_%d" % (i + 1), lit(v), editable=ed)
    for i in range(4):
        b.attr("CHAN_BOND_SEQ_2_%d" % (i + 1), lit(ZERO11), editable=ed)
    if family != "GT":
        b.attr("CHAN_BOND_SEQ_1_MASK", lit(mask_for(t.cb_len)), editable=ed)
        b.attr("CHAN_BOND_SEQ_2_MASK", lit("1111"), editable=ed)
    if "Infiniband" in t.display and family != "GT11":
        b.attr("LANE_ID", ZERO11)


# --------------------------------------------------------------------------
def gt_block(t, width):
    b = Block(t.prim(width) + "_INST", t.prim(width))
    ed = not t.fixed
    general_common(b, t, "GT", width)
    b.attr("SERDES_10B", "FALSE", TF)
    b.attr("TERMINATION_IMP", "50", ["50", "75"])
    b.attr("REF_CLK_V_SEL", "0", ["0", "1"])
    b.attr("QVZX_ONLY_REFCLK_DYN", "DYNAMIC", ["DYNAMIC", "STATIC"])
    b.attr("QVZX_ONLY_REFCLK", "REFCLK", ["REFCLK", "REFCLK2"])
    b.attr("QVZX_ONLY_BREFCLK_DYN", "DYNAMIC", ["DYNAMIC", "STATIC"])
    b.attr("QVZX_ONLY_BREFCLK", "BREFCLK", ["BREFCLK", "BREFCLK2"])
    b.attr("QVZX_ONLY_BYPASS_PCS", "FALSE", TF, editable=ed)
    transmitter(b, t, "GT")
    comma(b, t, "GT")
    receiver(b, t, "GT")
    clock_correction(b, t, "GT")
    channel_bonding(b, t, "GT")
    n = int(width)
    for name in ("REFCLK", "REFCLK2", "REFCLKSEL", "BREFCLK", "BREFCLK2"):
        b.pin(name, "IN")
    b.pin("CONFIGENABLE", "IN")
    b.pin("CONFIGIN", "IN")
    b.pin("CONFIGOUT", "OUT")
    common_pins(b, n, chbond=4)
    b.pin("TXFORCECRCERR", "IN")
    b.pin("RXCHECKINGCRC", "OUT")
    b.pin("RXCRCERR", "OUT")
    return b


def common_pins(b, n, chbond, gt11=False):
    b.pin("POWERDOWN", "IN")
    b.pin("LOOPBACK", "IN", 2)
    b.pin("TXRESET", "IN")
    b.pin("RXRESET", "IN")
    for name in ("TXUSRCLK", "TXUSRCLK2", "RXUSRCLK", "RXUSRCLK2"):
        b.pin(name, "IN")
    b.pin("TXDATA", "IN", 8 * n, True)
    for name in ("TXCHARISK", "TXCHARDISPMODE", "TXCHARDISPVAL", "TXBYPASS8B10B"):
        b.pin(name, "IN", n, True)
    b.pin("TXKERR", "OUT", n, True)
    b.pin("TXRUNDISP", "OUT", n, True)
    b.pin("TXPOLARITY", "IN")
    b.pin("TXINHIBIT", "IN")
    b.pin("TXBUFERR", "OUT")
    b.pin("TXP", "OUT")
    b.pin("TXN", "OUT")
    b.pin("RXP", "IN")
    b.pin("RXN", "IN")
    b.pin("RXDATA", "OUT", 8 * n, True)
    for name in ("RXCHARISK", "RXCHARISCOMMA", "RXDISPERR", "RXNOTINTABLE", "RXRUNDISP"):
        b.pin(name, "OUT", n, True)
    b.pin("RXCOMMADET", "OUT")
    b.pin("RXREALIGN", "OUT")
    b.pin("RXLOSSOFSYNC", "OUT", 2)
    b.pin("RXCLKCORCNT", "OUT", 3)
    b.pin("RXBUFSTATUS", "OUT", 2)
    b.pin("RXPOLARITY", "IN")
    b.pin("RXRECCLK" + ("1" if gt11 else ""), "OUT")
    if gt11:
        b.pin("TXOUTCLK1", "OUT")
    b.pin("ENPCOMMAALIGN", "IN")
    b.pin("ENMCOMMAALIGN", "IN")
    b.pin("ENCHANSYNC", "IN")
    b.pin("CHBONDDONE", "OUT")
    b.pin("CHBONDI", "IN", chbond)
    b.pin("CHBONDO", "OUT", chbond)


def coding_pins(b):
    b.pin("TXENC8B10BUSE", "IN")
    for name in ("TXENC64B66BUSE", "TXGEARBOX64B66BUSE", "TXSCRAM64B66BUSE"):
        b.pin(name, "IN")
    b.pin("TXINTDATAWIDTH", "IN", 2)
    b.pin("RXDEC8B10BUSE", "IN")
    for name in ("RXDEC64B66BUSE", "RXBLOCKSYNC64B66BUSE", "RXDESCRAM64B66BUSE", "RXIGNOREBTF"):
        b.pin(name, "IN")
    b.pin("RXINTDATAWIDTH", "IN", 2)


def gt10_block(t, width, widths_in_block):
    b = Block(t.prim(width) + "_INST", t.prim(width))
    ed = not t.fixed
    general_common(b, t, "GT10", width)
    # PMA speeds: per data width, and which encodings each speed allows
    all_speeds = []
    for w in widths_in_block:
        all_speeds += speeds_for(t, w)
    b.attr("PMA_SPEED", speeds_for(t, width)[0], all_speeds)
    for w in widths_in_block:
        s = speeds_for(t, w)
        b.attr("QVZ_PMA_SPEED_%s" % w, s[0], s)
    for enc in ("NONE", "8B10B", "64B66B"):
        if t.fixed:
            allowed = all_speeds if t.enc == enc else []
        else:
            allowed = [s for s in all_speeds if enc in SPEED_CLASSES[speed_class(s)]]
        b.attr("QVZ_PMASPD_ENC_" + enc, allowed[0] if allowed else "", allowed)
    b.attr("QVZX_ONLY_ENABLE_PMA", "FALSE", TF)
    b.attr("QVZX_ONLY_USE_REFCLK", "TRUE", TF)
    b.attr("QVZX_ONLY_USE_BREFCLK", "FALSE", TF)
    b.attr("QVZX_ONLY_REFCLK_DYN", "DYNAMIC", ["DYNAMIC", "STATIC"])
    b.attr("QVZX_ONLY_REFCLK", "REFCLK", ["REFCLK", "REFCLK2"])
    b.attr("QVZX_ONLY_BYPASS_PCS", "FALSE", TF, editable=ed)
    transmitter(b, t, "GT10")
    comma(b, t, "GT10")
    receiver(b, t, "GT10")
    clock_correction(b, t, "GT10")
    channel_bonding(b, t, "GT10")
    n = max(int(w) for w in widths_in_block)
    for name in ("REFCLK", "REFCLK2", "REFCLKSEL", "REFCLKBSEL", "BREFCLKPIN", "BREFCLKNIN"):
        b.pin(name, "IN")
    b.pin("PMAINIT", "IN")
    b.pin("PMAREGADDR", "IN", 6)
    b.pin("PMAREGDATAIN", "IN", 8)
    b.pin("PMAREGRW", "IN")
    b.pin("PMAREGSTROBE", "IN")
    common_pins(b, n, chbond=5)
    coding_pins(b)
    b.pin("TXOUTCLK", "OUT")
    # left over from the first family's pin set; the GT10 write removes them
    b.pin("TXFORCECRCERR", "IN")
    b.pin("RXCHECKINGCRC", "OUT")
    b.pin("RXCRCERR", "OUT")
    return b


def gt11_block(t, width):
    b = Block(t.prim(width) + "_INST", t.prim(width))
    b.crc_bytes = width
    general_common(b, t, "GT11", width)
    b.attr("QVZ_GT11_MODE", "DUAL", ["SINGLE", "DUAL"])
    b.attr("QVZ_GT11_USE_B", "TRUE", TF)
    b.attr("GT11_MODE", "B", ["A", "B", "DONT_CARE"])
    b.attr("TXABPMACLKSEL", "REFCLK1", ["REFCLK1", "REFCLK2", "GREFCLK"])
    b.attr("RXPMACLKSEL", "REFCLK1", ["REFCLK1", "REFCLK2", "GREFCLK"])
    b.attr("TXPLLNDIVSEL", "20", ["8", "10", "16", "20", "32", "40"])
    b.attr("RXPLLNDIVSEL", "20", ["8", "10", "16", "20", "32", "40"])
    b.attr("TXFDCAL_CLOCK_DIVIDE", "NONE", ["NONE", "TWO", "FOUR"])
    b.attr("RXFDCAL_CLOCK_DIVIDE", "NONE", ["NONE", "TWO", "FOUR"])
    transmitter(b, t, "GT11")
    comma(b, t, "GT11")
    receiver(b, t, "GT11")
    clock_correction(b, t, "GT11")
    channel_bonding(b, t, "GT11")
    for name in ("REFCLK1", "REFCLK2", "GREFCLK"):
        b.pin(name, "IN")
    b.pin("COMBUSIN", "IN", 16)
    b.pin("COMBUSOUT", "OUT", 16)
    # Every GT11 primitive is the full 8-byte transceiver; the data width is
    # chosen through RXDATAWIDTH and TXDATAWIDTH.
    common_pins(b, 8, chbond=5, gt11=True)
    coding_pins(b)
    b.pin("TXDATAWIDTH", "IN", 2)
    b.pin("RXDATAWIDTH", "IN", 2)
    b.pin("RXMCLK", "OUT")
    for side in ("TX", "RX"):
        b.pin(side + "CRCCLK", "IN")
        b.pin(side + "CRCINTCLK", "IN")
        b.pin(side + "CRCDATAVALID", "IN")
        b.pin(side + "CRCDATAWIDTH", "IN", 3)
        b.pin(side + "CRCIN", "IN", 64)
        b.pin(side + "CRCINIT", "IN")
        b.pin(side + "CRCOUT", "OUT", 32)
        b.pin(side + "CRCPD", "IN")
        b.pin(side + "CRCRESET", "IN")
    return b


# --------------------------------------------------------------------------
GT_TYPES = [
    Type("Custom", "GT_CUSTOM", ["1", "2", "4"], single=True, fixed=False,
         cc_len="2", cc=seq4(K28_5, D21_5)),
    Type("FibreChannel", "GT_FIBRE_CHAN", ["1", "2", "4"], single=True,
         cc_len="4", cc=seq4(K28_5, D21_4, D21_5, D21_5), crc_format="FIBRE_CHAN"),
    Type("Ethernet", "GT_ETHERNET", ["1", "2", "4"], single=True,
         cc_len="2", cc=seq4(K28_5, D16_2), crc_format="ETHERNET", sop="K27_7"),
    Type("Infiniband", "GT_INFINIBAND", ["1", "2", "4"], single=True,
         cc_len="4", cc=seq4(K28_5, K28_0, K28_0, K28_0), crc_format="INFINIBAND",
         cb_len="4", cb=seq4(K28_5, ZERO11, D10_2, D10_2)),
    Type("Zephine", "GT_ZEPHINE", ["1", "2", "4"], single=True,
         cc_len="4", cc=seq4(K28_5, K23_7, K23_7, K23_7)),
]

EIGHT_B = {"A", "B"}
SIXTY_FOUR_B = {"C", "D"}
GT10_TYPES = [
    Type("10G Custom", "GT10_CUSTOM", ["1", "2", "4", "8"], single=True, fixed=False,
         cc_len="2", cc=seq4(K28_5, D21_5), speeds={"A", "B", "C", "D"}),
    Type("Zephine", "GT10_ZEPHINE_%s", ["1", "2", "4"],
         cc=seq4(K28_5, K23_7, K23_7, K23_7), speeds=EIGHT_B),
    Type("PCI Express", "GT10_PCI_EXPRESS_%s", ["1", "2", "4"],
         cc=seq4(K28_5, K28_0, K28_0, K28_0), cb=seq4(K28_5), speeds=EIGHT_B),
    Type("Infiniband", "GT10_INFINIBAND_%s", ["1", "2", "4"],
         cc=seq4(K28_5, K28_0, K28_0, K28_0), cb_len="4",
         cb=seq4(K28_5, ZERO11, D10_2, D10_2), speeds=EIGHT_B),
    Type("XAUI", "GT10_XAUI_%s", ["2", "4"], cc_len="1", cc=seq4(K28_0),
         bond="4", bond_fixed=True, speeds=EIGHT_B),
    Type("OC48", "GT10_OC48_%s", ["2", "4"], enc="NONE", cc_len="1", cc=seq4(ZERO11),
         speeds=EIGHT_B),
    Type("OC192", "GT10_OC192_%s", ["4", "8"], enc="NONE", cc_len="1", cc=seq4(ZERO11),
         speeds={"C"}),
    Type("Ethernet", "GT10_10GE_%s", ["2", "4", "8"], enc="64B66B", cc_len="1",
         cc=seq4(IDLE_64B), speeds=SIXTY_FOUR_B),
    Type("FibreChannel", "GT10_10GFC_%s", ["4", "8"], enc="64B66B", cc_len="1",
         cc=seq4(IDLE_64B), speeds=SIXTY_FOUR_B),
    Type("ZephineX", "GT10_ZEPHINEX_%s", ["4", "8"], enc="64B66B", cc_len="1",
         cc=seq4(IDLE_64B), speeds=SIXTY_FOUR_B),
]

GT11_TYPES = [
    Type("Custom", "GT11_CUSTOM", ["1", "2", "4", "8"], single=True, fixed=False,
         cc_len="2", cc=seq4(K28_5, D21_5)),
    Type("XAUI", "GT11_XAUI_%s", ["2", "4"], cc_len="1", cc=seq4(K28_0),
         bond="4", bond_fixed=True),
]


def family_blocks(family):
    blocks = []
    if family == "GT":
        for t in GT_TYPES:
            blocks.append(gt_block(t, "4"))
    elif family == "GT10":
        for t in GT10_TYPES:
            if t.single:
                blocks.append(gt10_block(t, "4", t.widths))
            else:
                for w in t.widths:
                    blocks.append(gt10_block(t, w, [w]))
    else:
        for t in GT11_TYPES:
            for w in (["4"] if t.single else t.widths):
                blocks.append(gt11_block(t, w))
    return blocks


def design(family, blocks, active, file_name):
    found = False
    for b in blocks:
        b.used = b.name == active
        found = found or b.used
    if not found:
        raise KeyError(active)
    return {
        "format": "velomux-design-data",
        "version": 1,
        "target": {"families": [family], "max_bond": {family: MAX_BOND[family]},
                   "file_name": file_name},
        "blocks": [b.to_json() for b in blocks],
        "signals": [],
    }


# --------------------------------------------------------------------------
# Output: one attribute or pin per line, so that a change reads as one line.
def dump(doc):
    def one(x):
        return json.dumps(x, ensure_ascii=False)

    lines = ["{"]
    lines.append(' "format": %s,' % one(doc["format"]))
    lines.append(' "version": %d,' % doc["version"])
    lines.append(' "target": %s,' % one(doc["target"]))
    lines.append(' "blocks": [')
    for bi, b in enumerate(doc["blocks"]):
        lines.append("  {")
        head = {key: b[key] for key in ("name", "primitive", "used") if key in b}
        for key, value in head.items():
            lines.append("   %s: %s," % (one(key), one(value)))
        for section in ("attributes", "pins"):
            lines.append('   "%s": [' % section)
            items = b[section]
            for ii, item in enumerate(items):
                lines.append("    " + one(item) + ("," if ii + 1 < len(items) else ""))
            lines.append("   ]" + ("," if section == "attributes" else ""))
        lines.append("  }" + ("," if bi + 1 < len(doc["blocks"]) else ""))
    lines.append(" ],")
    lines.append(' "signals": %s' % one(doc["signals"]))
    lines.append("}")
    return "\n".join(lines) + "\n"


def write(rel, doc):
    path = os.path.join(ROOT, rel)
    os.makedirs(os.path.dirname(path), exist_ok=True)
    text = dump(doc)
    json.loads(text)  # the output must stay valid JSON
    with open(path, "w", encoding="utf-8") as f:
        f.write(text)


# --------------------------------------------------------------------------
def find(blocks, name):
    for b in blocks:
        if b.name == name:
            return b
    raise KeyError(name)


def examples():
    # A 2-byte Ethernet link on GT10.
    blocks = family_blocks("GT10")
    write("examples/gt10-ethernet-2byte.json",
          design("GT10", blocks, "GT10_10GE_2_INST", "eth_link_top"))

    # A custom link of four bonded transceivers on the first family, 2 bytes wide.
    blocks = family_blocks("GT")
    b = find(blocks, "GT_CUSTOM_INST")
    for name in ("RX_DATA_WIDTH", "TX_DATA_WIDTH"):
        b.set(name, "2")
    b.set("QVZ_CHAN_BOND_NUMBER", "4")
    b.set("CHAN_BOND_SEQ_LEN", "2")
    b.set("CHAN_BOND_SEQ_1_2", K28_3)
    write("examples/gt-custom-bonded4.json",
          design("GT", blocks, "GT_CUSTOM_INST", "bonded_link_top"))

    # GT11: both transceivers of each tile, four bonded (two tiles).
    blocks = family_blocks("GT11")
    b = find(blocks, "GT11_CUSTOM_INST")
    b.set("QVZ_CHAN_BOND_NUMBER", "4")
    b.set("QVZ_CHAN_BOND_PRIMARY_ROW", "0")
    write("examples/gt11-dual-bonded.json",
          design("GT11", blocks, "GT11_CUSTOM_INST", "dual_tile_top"))

    # A design saved with the obsolete GT10_ZEPHINE_8 active.
    blocks = family_blocks("GT10")
    zephine = next(t for t in GT10_TYPES if t.display == "Zephine")
    old = Type("Zephine_8", "GT10_ZEPHINE_8", ["8"], cc=zephine.cc, speeds=EIGHT_B)
    old_block = gt10_block(old, "8", ["8"])
    at = blocks.index(find(blocks, "GT10_ZEPHINE_4_INST")) + 1
    blocks.insert(at, old_block)
    write("examples/gt10-legacy-zephine8.json",
          design("GT10", blocks, "GT10_ZEPHINE_8_INST", "legacy_zephine_top"))

    # A design saved with a GT10_3GIO block: older attribute names, and a
    # PCI Express link of four transceivers that carries over.
    blocks = family_blocks("GT10")
    pcie = next(t for t in GT10_TYPES if t.display == "PCI Express")
    gio_type = Type("3GIO", "GT10_3GIO_%s", ["1", "2", "4"], cc=pcie.cc, cb=pcie.cb,
                    speeds=EIGHT_B)
    gio = gt10_block(gio_type, "2", ["2"])
    renames = {"QVZ_RX_DATA_WIDTH": "RX_DATA_WIDTH", "QVZ_TX_DATA_WIDTH": "TX_DATA_WIDTH",
               "QVZ_BOOL_TX_USE": "BOOL_TX_USE", "QVZ_BOOL_RX_USE": "BOOL_RX_USE"}
    for a in gio.attrs:
        a["name"] = renames.get(a["name"], a["name"])
    gio.set("QVZ_CHAN_BOND_NUMBER", "4")
    gio.set("PMA_SPEED", "1_16")
    at = blocks.index(find(blocks, "GT10_PCI_EXPRESS_4_INST")) + 1
    blocks.insert(at, gio)
    write("examples/gt10-legacy-3gio.json",
          design("GT10", blocks, "GT10_3GIO_2_INST", "legacy_pcie_top"))


def main():
    write("data/targets/gt.json",
          design("GT", family_blocks("GT"), "GT_FIBRE_CHAN_INST", "gt_top"))
    write("data/targets/gt10.json",
          design("GT10", family_blocks("GT10"), "GT10_CUSTOM_INST", "gt10_top"))
    write("data/targets/gt11.json",
          design("GT11", family_blocks("GT11"), "GT11_CUSTOM_INST", "gt11_top"))
    examples()
    return 0


if __name__ == "__main__":
    sys.exit(main())
