#include "qm_base/msgfunction.h"

#include "qm_base/messagecatalogue.h"
#include "qm_base/messagesources.h"
#include "qm_base/messagetext.h"

#include <atomic>
#include <vector>

namespace zql::lib {

namespace {

constexpr std::size_t kEnglish = 0; // the fall-back stands first

/// The catalogues in the order of MessageSources(), read once. Their faults are a matter of the
/// message audit, which runs as a test.
const std::vector<CMessageCatalogue>& Catalogues()
{
    static const std::vector<CMessageCatalogue> catalogues = [] {
        std::vector<CMessageCatalogue> read;
        for (const T_MESSAGE_SOURCE& source : MessageSources())
            read.emplace_back().Read(source.text);
        return read;
    }();
    return catalogues;
}

std::atomic<std::size_t>& Chosen()
{
    static std::atomic<std::size_t> chosen = kEnglish;
    return chosen;
}

/// Position of the language, or the number of languages when there is no such language.
std::size_t IndexOf(std::string_view language)
{
    const auto sources = MessageSources();
    std::size_t i = 0;
    while (i < sources.size() && sources[i].language != language)
        ++i;
    return i;
}

} // namespace

std::string MMSGFunction::GetValue(std::string_view key)
{
    return TextIn(Catalogues()[Chosen()], Catalogues()[kEnglish], key);
}

std::string MMSGFunction::Format(std::string_view key, std::initializer_list<std::string_view> args)
{
    return FillPlaces(GetValue(key), {args.begin(), args.size()});
}

int MMSGFunction::SetLanguage(std::string_view code)
{
    const std::size_t i = IndexOf(code);
    if (i == MessageSources().size()) return 0;
    Chosen() = i;
    return 1;
}

std::string MMSGFunction::GetLanguage()
{
    return std::string(MessageSources()[Chosen()].language);
}

std::string MMSGFunction::GetValueOf(std::string_view language, std::string_view key)
{
    const std::size_t i = IndexOf(language);
    if (i == MessageSources().size()) return {};
    const std::string* const text = Catalogues()[i].Find(key);
    return text ? *text : std::string();
}

std::string MMSGFunction::RemoveQuote(std::string_view text)
{
    if (text.size() >= 2 && text.front() == '"' && text.back() == '"')
        text = text.substr(1, text.size() - 2);
    return std::string(text);
}

} // namespace zql::lib
