// Arbitrary bytes as a design-data file: the loader must refuse them with a
// message or accept them, and what it accepts must run and save cleanly.

#include "FuzzCommon.h"

#include <cstddef>
#include <cstdint>

extern "C" int LLVMFuzzerInitialize(int* argc, char*** argv) {
    VelomuxFuzz::InitApplication(argc, argv);
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    const QByteArray text(reinterpret_cast<const char*>(bytes), qsizetype(size));
    Qvz_WizData data;
    QString error;
    if (!Qvz_DesignJson::Load(text, "input", data, error)) {
        if (error.isEmpty())
            VelomuxFuzz::Finding("the loader refused without a message", text);
        // Invalid inputs stay in the corpus: they are steps towards valid ones.
        return 0;
    }
    if (!error.isEmpty())
        VelomuxFuzz::Finding("the loader accepted and reported an error", error.toUtf8());
    VelomuxFuzz::RunAndRoundTrip(data);
    return 0;
}
