#include <gtest/gtest.h>
#include <xercesc/util/PlatformUtils.hpp>

#if !defined(_WIN32)
#include <arpa/inet.h>
#include <sys/socket.h>
#include <unistd.h>
#endif

#include <algorithm>
#include <atomic>
#include <string>
#include <thread>
#include <tuple>
#include <vector>

#include "kxutil/kxglob.h"
#include "schema/fixfieldlist.h"
#include "schema/loadschema.h"
#include "testutil.h"

namespace {

struct XercesEnv : ::testing::Environment {
    void SetUp() override { xercesc::XMLPlatformUtils::Initialize(); }
    void TearDown() override { xercesc::XMLPlatformUtils::Terminate(); }
};
[[maybe_unused]] auto* const env = ::testing::AddGlobalTestEnvironment(new XercesEnv);

std::string ascii(const KXWString& s) {
    return std::string(s.c_str(), s.c_str() + s.length());
}

// A schema file loaded into a fresh handler, with the log lines the load wrote.
struct Loaded {
    explicit Loaded(const std::string& path) {
        KXGlob::SetLogSink([](int32_t, BATCHERR, const char* line,
                              void* self) { static_cast<Loaded*>(self)->log.emplace_back(line); },
                           this);
        ok = loadSchema(spec, path.c_str());
        KXGlob::SetLogSink(nullptr, nullptr);
    }
    std::vector<std::string> keys() {
        std::vector<std::string> out;
        for (const auto& entry : spec.getFieldMap()) out.push_back(ascii(entry.first));
        return out;
    }
    FIXField* at(const char16_t* key) { return spec.getFieldMap().at(KXWString(key)); }
    FIXKXSchemaSpec spec;
    std::vector<std::string> log;
    bool ok = false;
};

struct LoadedText : testutil::TempFile, Loaded {
    explicit LoadedText(const std::string& xml) : TempFile(xml, ".xml"), Loaded(path()) {}
};

std::string fields(const std::string& body) {
    return "<Spec><Title>t</Title><Transaction>" + body + "</Transaction></Spec>";
}

// "qualified tag kind requirement ordinal owner", each node before its children.
void rows(const FIXField& node, const std::string& owner, std::vector<std::string>& out) {
    const std::string qualified = ascii(node.getQualifiedTag());
    out.push_back(qualified + ' ' + ascii(node.getTag()) + ' ' + "GF"[node.getIsField()] + ' ' +
                  "ROC"[node.getRequirement()] + ' ' + std::to_string(node.getOrdinal()) + ' ' +
                  owner);
    const FIXFieldList* children = node.getChildren();
    for (int32_t i = 0; children != nullptr && i < children->getCount(); ++i)
        rows(*children->getAt(i), qualified, out);
}

TEST(SchemaReader, BuildsTheModelOfAWorkedSchema) {
    const std::string longValue(100000, 'x');  // longer than the parser's buffers
    LoadedText s(fields(
        "<Field><Tag>8</Tag><Requirement>R</Requirement><Name> Begin String </Name><Value> A&amp;B"
        "|&#67;&#x1F600;|<![CDATA[<D>]]> </Value></Field>"
        "<Field><Tag>9</Tag><Requirement>C</Requirement></Field>"
        "<Group><Field><Tag>100</Tag><Requirement>R</Requirement></Field><Sequence>"
        "<Field><Tag>78</Tag><Requirement>maybe</Requirement></Field>"
        "<Group><Field><Tag>200</Tag><Requirement>C</Requirement></Field>"
        "<Sequence><Field><Tag>79</Tag><Requirement>O</Requirement></Field></Sequence></Group>"
        "</Sequence></Group><Field><Tag>10</Tag><Value>" +
        longValue + "</Value></Field>"));
    ASSERT_TRUE(s.ok);
    EXPECT_EQ(s.keys(), (std::vector<std::string>{"10", "100", "200", "8", "9"}));
    std::vector<std::string> table;
    for (const char16_t* root : {u"8", u"9", u"100", u"10"}) rows(*s.at(root), "-", table);
    EXPECT_EQ(table,
              (std::vector<std::string>{"8 8 F R 0 -", "9 9 F C 1 -", "G.100 G.100 G R 2 -",
                                        "[G.100]100 100 F R 3 G.100", "[G.100]78 78 F O 4 G.100",
                                        "[G.100]G.200 G.200 G C 5 G.100",
                                        "[G.100!G.200]200 200 F C 6 [G.100]G.200",
                                        "[G.100!G.200]79 79 F O 7 [G.100]G.200", "10 10 F O 8 -"}));
    // A nested group is also found under its counter, as the same node.
    EXPECT_EQ(s.at(u"200"), s.at(u"100")->getChildren()->getAt(2));
    // Text arrives whole, references resolved, nothing trimmed.
    EXPECT_EQ(std::u16string(s.at(u"8")->getName().c_str()), u" Begin String ");
    EXPECT_EQ(std::u16string(s.at(u"8")->getValue().c_str()), u" A&B|C\U0001F600|<D> ");
    EXPECT_EQ(ascii(s.at(u"10")->getValue()), longValue);
}

TEST(SchemaReader, LogsEachParserDiagnosticOnce) {
    const std::tuple<const char*, bool, const char*> cases[] = {
        {"<S>\n<Transaction><Field></Transaction></S>", false,
         "Browser: Fatal: At line 2, column 23 of file "},
        {"", false, "Browser: Fatal: At line 1, column 1 of file "},
        {"<!DOCTYPE S [<!ATTLIST S a CDATA #IMPLIED><!ATTLIST S a CDATA #IMPLIED>]><S/>", true,
         "Browser: Warning: At line 1, column "},
    };
    for (const auto& [doc, ok, start] : cases) {
        SCOPED_TRACE(doc);
        LoadedText s(doc);
        EXPECT_EQ(s.ok, ok);
        ASSERT_EQ(s.log.size(), 1u);
        EXPECT_TRUE(s.log[0].rfind(start, 0) == 0 &&
                    s.log[0].find(" of file " + s.path() + ": ") != std::string::npos)
            << s.log[0];
    }
    EXPECT_FALSE(Loaded("/nonexistent/schema.xml").ok);
}

TEST(SchemaReader, ReadsLocalEntitiesButNothingFromTheNetwork) {
#if defined(_WIN32)
    GTEST_SKIP() << "the loopback listener that counts fetches uses POSIX sockets";
#else
    // A loopback listener counts what would have been fetched.
    const int listener = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address{AF_INET, 0, {htonl(INADDR_LOOPBACK)}, {}};
    socklen_t size = sizeof address;
    ASSERT_TRUE(bind(listener, reinterpret_cast<sockaddr*>(&address), size) == 0 &&
                listen(listener, 4) == 0);
    getsockname(listener, reinterpret_cast<sockaddr*>(&address), &size);
    std::atomic<int> connections{0};
    std::thread server([&] {
        for (int c; (c = accept(listener, nullptr, nullptr)) >= 0; ::close(c)) ++connections;
    });
    const std::string url = "http://127.0.0.1:" + std::to_string(ntohs(address.sin_port)) + "/p";
    const testutil::TempFile defs("<!ENTITY yn 'Y|N'>", ".ent"), text("A|B", ".txt");
    LoadedText s("<!DOCTYPE Spec [<!ENTITY % defs SYSTEM '" +
                 defs.path().substr(defs.path().rfind('/') + 1) + "'> %defs; <!ENTITY ab SYSTEM " +
                 "'file://" + text.path() + "'> <!ENTITY % far SYSTEM '" + url + "'> %far;]>" +
                 fields("<Field><Tag>1</Tag><Value>&yn;|&ab;</Value></Field>"));
    shutdown(listener, SHUT_RDWR);
    server.join();
    ::close(listener);
    EXPECT_EQ(connections.load(), 0);
    EXPECT_FALSE(s.ok);
    ASSERT_EQ(s.log.size(), 1u);
    EXPECT_TRUE(s.log[0].rfind("Browser: Fatal: ", 0) == 0 &&
                s.log[0].find(url) != std::string::npos)
        << s.log[0];
    EXPECT_EQ(std::u16string(s.at(u"1")->getValue().c_str()), u"Y|N|A|B");
#endif
}

// Misplaced and unfinished elements: the sanitizer build reports any leak or double free.
TEST(SchemaReader, MisplacedElementsNeitherLeakNorDoubleFree) {
    const std::tuple<const char*, bool, std::vector<std::string>> cases[] = {
        {"<Field><Tag>1</Tag><Field><Tag>2</Tag></Field></Field>", true, {"1", "2"}},
        {"<Field><Tag>1</Tag><Group><Field><Tag>2</Tag></Field></Group></Field>", true, {"1", "2"}},
        {"<Tag>1</Tag><Requirement>R</Requirement><Field><Tag>2</Tag></Field>", true, {"2"}},
        {"<Group><Sequence><Field><Tag>3</Tag></Field></Sequence></Group>", true, {}},
        {"<Field><Tag>1</Tag>", false, {}},
        {"<Group><Field><Tag>1</Tag></Field><Sequence><Group><Field><Tag>2</Tag>",
         false,
         {"1", "2"}},
    };
    for (const auto& [body, ok, keys] : cases) {
        SCOPED_TRACE(body);
        const std::string doc = fields(body);  // the unfinished ones end after their body
        LoadedText s(ok ? doc : doc.substr(0, doc.find("</Transaction>")));
        EXPECT_EQ(s.ok, ok);
        EXPECT_EQ(s.keys(), keys);
        // The only Requirement given, outside any Field, reaches no node.
        for (const auto& entry : s.spec.getFieldMap())
            EXPECT_EQ(entry.second->getRequirement(), Optional) << ascii(entry.first);
    }
}

TEST(SchemaReader, WideSchemasLoadAndDeepOnesAreRefused) {
    std::string wide, deep;
    for (int i = 1; i <= 100000; ++i) {
        wide += "<Field><Tag>" + std::to_string(i) + "</Tag></Field>";
        deep += "<Group><Field><Tag>" + std::to_string(i) + "</Tag></Field><Sequence>";
    }
    LoadedText flat(fields(wide));
    EXPECT_TRUE(flat.ok && flat.log.empty());
    EXPECT_EQ(flat.spec.getFieldMap().size(), 100000U);
    for (int i = 0; i < 100000; ++i) deep += "</Sequence></Group>";
    LoadedText nested(fields(deep));
    EXPECT_FALSE(nested.ok);
    ASSERT_EQ(nested.log.size(), 1U);
    EXPECT_NE(nested.log[0].find("Browser: Fatal: At line 1, column "), std::string::npos);
    EXPECT_NE(nested.log[0].find("Groups nested deeper than 100 are refused"), std::string::npos);
    EXPECT_EQ(nested.spec.getFieldMap().size(), 100U);  // what was built is kept, and freed
}

TEST(SchemaReader, LoadsTheBundledSchema) {
    Loaded s(KXVFIX_SOURCE_DIR "/schemas/FIX44.xml");
    ASSERT_TRUE(s.ok && s.log.empty());
    const FIXFieldMap& map = s.spec.getFieldMap();
    const auto groups = std::count_if(
        map.begin(), map.end(), [](const auto& entry) { return entry.second->getIsField() == 0; });
    EXPECT_GT(static_cast<long>(map.size()) - groups, 500);
    EXPECT_GT(groups, 40);
}

}  // namespace
