// A case file is refused in one line, or gives a model that a model file could hold and that prints
// as a case file of the same model.
#include "fuzzcheck.h"
#include "qm_db/casefile.h"
#include "qm_db/records/modelfault.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    T_MODEL_CONTENT content, again;
    T_FILE_ERROR error;
    if (!CCaseFile::Parse(TextOf(data, size), "case.json", "/nowhere", content, error)) {
        ExpectOneLine(error.text);
        return 0;
    }
    const std::string fault = ModelFault(content.model);
    Expect(fault.empty(), "what a case file passes, a model passes", fault);
    std::string text;
    Expect(CCaseFile::Print(content, text, error) != 0, "what is read can be printed", error.text);
    Expect(CCaseFile::Parse(text, "case.json", "/nowhere", again, error) != 0,
           "what is printed can be read", error.text + '\n' + text);
    Expect(again.model == content.model, "reading, printing and reading give the same", text);
    return 0;
}
