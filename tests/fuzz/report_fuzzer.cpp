// Feeds arbitrary bytes to the report readers and the text operations. The input is a text,
// and, after its first NUL byte, a separator; each call must return, and the results must
// agree with each other.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "platform/core/text.h"
#include "results/report_text.h"

namespace {
void Require(bool condition) {
    if (!condition) {
        std::abort();
    }
}
}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::string input(reinterpret_cast<const char*>(data), size);
    const size_t nul = input.find('\0');
    const std::string text = input.substr(0, nul);
    const std::string separator = nul == std::string::npos ? "\r" : input.substr(nul + 1);

    ListReadValue(text);
    PassesReportTest(text);
    for (auto read : {ReportReadValue, ReportCodeType, SymbolLength, Scale, Bwr, BarDeviance,
                      FreeLine, MeasurementsBlock, DeviancesBlock}) {
        read(text);
    }

    const long long fields = CountFields(text, separator);
    Require(fields >= 1);
    Require(NthField(text, separator, fields + 1).empty());
    size_t joined = 0;
    for (long long n = 1; n <= fields && n <= 64; ++n) {
        joined += NthField(text, separator, n).size();
    }
    Require(fields > 64 || joined <= text.size());
    const long long at = InStr(0, text, separator);
    Require(at >= 0 && at <= static_cast<long long>(text.size()));
    Require((at > 0) == (fields > 1) || separator.empty());
    Require(Left(text, at).size() <= text.size());
    Require(Trim(text).size() <= text.size());
    Int64FromDouble(Val(text));
    RuntimeStringCompare(text, separator);
    return 0;
}
