#include "Qvz_Messages.h"

#include <cstdio>

void Qvz_StderrSink::Show(const Qvz_Message& message) {
    std::fprintf(stderr, "%s%s\n", message.flag1 ? "error: " : "note: ", message.text.c_str());
    std::fflush(stderr);
}
