// A recorder table is refused in one line with its place, or gives columns of finite numbers. The
// first byte chooses the options.
#include "fuzzcheck.h"
#include "qm_db/file/recorderfile.h"

#include <cmath>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    if (size == 0) return 0;
    CRecorderFile::T_OPTIONS options;
    options.skipRows = data[0] & 3;
    options.decimal = static_cast<RECORDER_DECIMAL>((data[0] >> 2) % 3);
    CRecorderFile file;
    T_FILE_ERROR error;
    if (!file.Parse(TextOf(data + 1, size - 1), "r.out", options, error)) {
        ExpectOneLine(error.text);
        Expect(!file.IsLoaded(), "nothing is loaded of what is refused");
        return 0;
    }
    int column = 0;
    if (!file.FindColumn("a", column, error)) ExpectOneLine(error.text);
    for (column = 1; column <= 5; ++column) {
        std::vector<double> values(file.RowCount(), 0.0);
        if (!file.AddColumn(column, values, error)) ExpectOneLine(error.text);
        for (const double value : values)
            Expect(std::isfinite(value), "numbers are finite");
    }
    return 0;
}
