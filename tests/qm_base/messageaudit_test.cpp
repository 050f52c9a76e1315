#include "messageaudit.h"

#include "qm_base/messagesources.h"

#include <gtest/gtest.h>

namespace {

using Lines = std::vector<std::string>;

Lines Audit(const std::string& en, const std::string& it, const std::string& source)
{
    const T_AUDIT_TEXT catalogues[] = {{"en", en}, {"it", it}};
    const T_AUDIT_TEXT sources[] = {{"a.cpp", source}};
    return AuditMessages(catalogues, sources);
}

} // namespace

TEST(MessageAudit, FindsEachKindOfFault)
{
    const struct {
        const char* label;
        const char *en, *it, *source;
        Lines findings;
    } kCases[] = {
        {"sound", "IDS_A = {1} {2}", "IDS_A = {2} {1}", "f(\"IDS_A\");", {}},
        {"no text", "IDS_A = a", "IDS_A = a", "f(\"IDS_B\")", {"a.cpp: no text for IDS_B"}},
        {"beginning of keys", "IDS_A_B = a", "IDS_A_B = a", "f(\"IDS_A_\" + x)", {}},
        {"of none", "IDS_A = a", "IDS_A = a", "f(\"IDS_B_\" + x)", {"a.cpp: no text for IDS_B_"}},
        {"unknown", "IDS_A = a", "IDS_A = a\nIDS_C = c", "", {"it: unknown IDS_C"}},
        {"missing", "IDS_A = a\nIDS_B = b", "IDS_B = b", "", {"it: missing IDS_A"}},
        {"double it", "IDS_A = a", "IDS_A = a\nIDS_A = a", "", {"it line 2: IDS_A: stands twice"}},
        {"places", "IDS_A = {1}", "IDS_A = {2}", "", {"it: other places in IDS_A"}},
        {"no entry", "IDS_A = a", "IDS_A = a\nb", "", {"it line 2: not a line \"key = text\""}},
    };
    for (const auto& c : kCases)
        EXPECT_EQ(c.findings, Audit(c.en, c.it, c.source)) << c.label;
}

TEST(MessageAudit, CataloguesAndSourcesOfThisProgramAgree)
{
    std::vector<T_AUDIT_TEXT> catalogues;
    for (const auto& source : zql::lib::MessageSources())
        catalogues.push_back({std::string(source.language), std::string(source.text)});
    ASSERT_EQ(2u, catalogues.size());
    EXPECT_EQ("en", catalogues[0].name);

    std::vector<T_AUDIT_TEXT> sources = SourcesBelow(QM_AUDITED_SRC);
    const std::vector<T_AUDIT_TEXT> apps = SourcesBelow(QM_AUDITED_APPS);
    EXPECT_FALSE(sources.empty()) << "nothing found below " << QM_AUDITED_SRC;
    EXPECT_FALSE(apps.empty()) << "nothing found below " << QM_AUDITED_APPS;
    sources.insert(sources.end(), apps.begin(), apps.end());
    for (const std::string& finding : AuditMessages(catalogues, sources))
        ADD_FAILURE() << finding;
}
