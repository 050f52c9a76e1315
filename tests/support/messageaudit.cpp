#include "messageaudit.h"

#include "qm_base/messagecatalogue.h"
#include "qm_base/messagetext.h"
#include "tempfolder.h"

#include <algorithm>
#include <filesystem>

using zql::lib::CMessageCatalogue;

namespace {

void AuditPair(const CMessageCatalogue& reference, const CMessageCatalogue& other,
               const std::string& language, std::vector<std::string>& findings)
{
    for (const auto& [key, text] : reference.All()) {
        const std::string* const same = other.Find(key);
        if (!same)
            findings.push_back(language + ": missing " + key);
        else if (zql::lib::PlacesOf(text) != zql::lib::PlacesOf(*same))
            findings.push_back(language + ": other places in " + key);
    }
    for (const auto& [key, text] : other.All())
        if (!reference.Find(key)) findings.push_back(language + ": unknown " + key);
}

/// The keys that stand in a source as string literals, in order, repetitions included.
std::vector<std::string> KeysInSource(std::string_view source)
{
    constexpr std::string_view kStart = "\"IDS_";
    std::vector<std::string> keys;
    for (std::size_t at = source.find(kStart); at != std::string_view::npos;
         at = source.find(kStart, at)) {
        const std::size_t end = source.find('"', ++at);
        keys.emplace_back(source.substr(at, end - at));
        at = end == std::string_view::npos ? end : end + 1;
    }
    return keys;
}

/// A literal that ends in '_' is the beginning of keys that are put together: of some at least.
bool BeginsKeys(const CMessageCatalogue& catalogue, const std::string& key)
{
    return key.ends_with('_') && std::ranges::any_of(catalogue.All(), [&](const auto& entry) {
               return std::string_view(entry.first).starts_with(key);
           });
}

} // namespace

std::vector<std::string> AuditMessages(std::span<const T_AUDIT_TEXT> catalogues,
                                       std::span<const T_AUDIT_TEXT> sources)
{
    std::vector<std::string> findings;
    CMessageCatalogue reference;
    for (std::size_t i = 0; i < catalogues.size(); ++i) {
        CMessageCatalogue read;
        const std::string& language = catalogues[i].name;
        for (const auto& fault : read.Read(catalogues[i].text))
            findings.push_back(language + " line " + std::to_string(fault.line) + ": " +
                               fault.what);
        if (i > 0)
            AuditPair(reference, read, language, findings);
        else
            reference = std::move(read);
    }
    for (const T_AUDIT_TEXT& source : sources)
        for (const std::string& key : KeysInSource(source.text))
            if (!reference.Find(key) && !BeginsKeys(reference, key))
                findings.push_back(source.name + ": no text for " + key);
    return findings;
}

std::vector<T_AUDIT_TEXT> SourcesBelow(const std::string& folder)
{
    namespace fs = std::filesystem;
    std::vector<T_AUDIT_TEXT> sources;
    std::error_code error;
    for (const fs::directory_entry& entry : fs::recursive_directory_iterator(folder, error)) {
        const fs::path& path = entry.path();
        if (path.extension() == ".h" || path.extension() == ".cpp")
            sources.push_back({path.string(), ReadText(path)});
    }
    return sources;
}
