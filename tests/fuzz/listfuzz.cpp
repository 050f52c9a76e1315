// A list of elements is refused, or ascends and is what its own text says.
#include "fuzzcheck.h"
#include "qm_rps/desk/elementlist.h"

#include <algorithm>
#include <functional>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const auto ids = ParseElementList(std::string(TextOf(data, size)));
    if (!ids) return 0;
    Expect(std::ranges::adjacent_find(*ids, std::ranges::greater_equal()) == ids->end(),
           "a list ascends");
    Expect(ids->empty() || ids->front() > 0, "numbers are above 0");
    if (ids->size() < 100000) {
        const std::string text = ElementListText(*ids);
        Expect(ParseElementList(text) == ids, "the text of a list is that list", text);
    }
    return 0;
}
