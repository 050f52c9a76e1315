// Helper of killsave.sh: saves numbered contents in a loop, and checks what a kill has left.
//   killsave_helper save <model> <log>    saves content n + 1, n + 2, ...; writes n to <log> after
//                                         each save; n is what the model holds at the start, or 0
//   killsave_helper check <model> <log>   exit 0 when the model is whole and is the last content in
//                                         the log or the one after it
#include "modelstoresample.h"
#include "qm_db/modelstore.h"

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <unistd.h>

namespace {

T_MODEL_CONTENT NumberedContent(int number)
{
    T_MODEL_CONTENT content = GridContent(600 + number % 7 * 100, 40);
    content.model.styp.title = std::to_string(number);
    content.model.styp.gravity = number;
    return content;
}

int Fail(const std::string& text)
{
    std::fprintf(stderr, "killsave_helper: %s\n", text.c_str());
    return 1;
}

int SaveForEver(const std::string& model, const char* log)
{
    CModelStore store;
    T_FILE_ERROR error;
    T_MODEL_CONTENT content;
    int number = 0;
    if (std::filesystem::exists(model)) {
        if (!store.Open(model, OPEN_MODE::Edit, content, error)) return Fail(error.text);
        number = std::atoi(content.model.styp.title.c_str());
    }
    const int file = ::open(log, O_WRONLY | O_CREAT | O_TRUNC, 0644);
    for (;; ++number) {
        // written in one piece and never shortened, so that a kill can't leave half a number
        char line[16];
        std::snprintf(line, sizeof line, "%10d\n", number);
        if (number > 0 && ::pwrite(file, line, 11, 0) != 11) return Fail("log");
        if (!store.Save(model, NumberedContent(number + 1), error)) return Fail(error.text);
    }
}

int Check(const std::string& model, const char* log)
{
    T_FILE_ERROR error;
    T_MODEL_CONTENT content;
    CModelStore store;
    if (!store.Open(model, OPEN_MODE::Edit, content, error)) return Fail(error.text);
    const int number = std::atoi(content.model.styp.title.c_str());
    const int logged = std::atoi(BytesOf(log).c_str());
    if (logged > 0 && number != logged && number != logged + 1)
        return Fail("content " + std::to_string(number) + " after " + std::to_string(logged));
    if (!SameContent(NumberedContent(number), content)) return Fail("neither old nor new content");
    return 0;
}

} // namespace

int main(int argc, char** argv)
{
    if (argc == 4 && std::strcmp(argv[1], "save") == 0) return SaveForEver(argv[2], argv[3]);
    if (argc == 4 && std::strcmp(argv[1], "check") == 0) return Check(argv[2], argv[3]);
    return Fail("usage: save|check <model> <log>");
}
