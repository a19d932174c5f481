#pragma once
// The embedded sample targets and the worked examples, and what the wizard
// offers on each family: the files the target tests walk.

#include <QDir>
#include <QString>
#include <QStringList>

struct DesignFile {
    const char* path; // relative to the source tree
    const char* family;
    const char* activeBlock;
};

inline const DesignFile kTargets[] = {
    {"data/targets/gt.json", "GT", "GT_FIBRE_CHAN_INST"},
    {"data/targets/gt10.json", "GT10", "GT10_CUSTOM_INST"},
    {"data/targets/gt11.json", "GT11", "GT11_CUSTOM_INST"},
};

inline const DesignFile kExamples[] = {
    {"examples/gt10-ethernet-2byte.json", "GT10", "GT10_10GE_2_INST"},
    {"examples/gt-custom-bonded4.json", "GT", "GT_CUSTOM_INST"},
    {"examples/gt11-dual-bonded.json", "GT11", "GT11_CUSTOM_INST"},
    {"examples/gt10-legacy-zephine8.json", "GT10", "GT10_ZEPHINE_8_INST"},
    {"examples/gt10-legacy-3gio.json", "GT10", "GT10_3GIO_2_INST"},
};

// Every transceiver type the wizard offers on a family, with its data widths.
struct OfferedType {
    const char* target;
    const char* family;
    const char* type;
    QStringList widths;
};

inline const OfferedType kOffered[] = {
    {"gt", "GT", "Custom", {"1", "2", "4"}},
    {"gt", "GT", "FibreChannel", {"1", "2", "4"}},
    {"gt", "GT", "Ethernet", {"1", "2", "4"}},
    {"gt", "GT", "Infiniband", {"1", "2", "4"}},
    {"gt", "GT", "Zephine", {"1", "2", "4"}},
    {"gt10", "GT10", "10G Custom", {"1", "2", "4", "8"}},
    {"gt10", "GT10", "Zephine", {"1", "2", "4"}},
    {"gt10", "GT10", "PCI Express", {"1", "2", "4"}},
    {"gt10", "GT10", "Infiniband", {"1", "2", "4"}},
    {"gt10", "GT10", "XAUI", {"2", "4"}},
    {"gt10", "GT10", "OC48", {"2", "4"}},
    {"gt10", "GT10", "OC192", {"4", "8"}},
    {"gt10", "GT10", "Ethernet", {"2", "4", "8"}},
    {"gt10", "GT10", "FibreChannel", {"4", "8"}},
    {"gt10", "GT10", "ZephineX", {"4", "8"}},
    {"gt11", "GT11", "Custom", {"1", "2", "4", "8"}},
    {"gt11", "GT11", "XAUI", {"2", "4"}},
};

inline QString SourcePath(const char* rel) {
    return QDir(VELOMUX_SOURCE_DIR).filePath(rel);
}
