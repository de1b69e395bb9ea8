// The library's configuration files: the XML reader, the debug configuration and its log,
// and something other than a regular file at one of the library's file paths (a FIFO, a
// directory, a character device), which counts as no file: opening it never blocks,
// nothing is read from it and nothing is written into it.
#include <fcntl.h>
#include <signal.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <cerrno>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <functional>
#include <memory>
#include <regex>
#include <string>

#include "config/debug_config.h"
#include "config/stereo_profile.h"
#include "config/version_report.h"
#include "config/xml_reader.h"
#include "present/live_tuning.h"
#include "support/device_files.h"

namespace {

using ovo::XmlElement;

const char NO_DOCUMENT[] = "<no document>";

std::unique_ptr<XmlElement> Parse(std::string text) {
    FILE* stream = fmemopen(text.data(), text.size(), "r");
    std::unique_ptr<XmlElement> document(ovo::ParseXmlStream(stream));
    std::fclose(stream);
    return document;
}

// name[attr=value]...(text){child}...; a document has no name.
std::string Describe(const XmlElement* e) {
    if (e == nullptr) return NO_DOCUMENT;
    std::string out = e->GetName() != nullptr ? e->GetName() : "";
    for (int32_t i = 0; i < e->AttributeCount(); ++i) {
        const ovo::XmlAttribute& a = *e->GetAttribute(i);
        out += std::string("[") + a.GetName() + "=" + a.GetValue() + "]";
    }
    if (e->GetValue() != nullptr) out += std::string("(") + e->GetValue() + ")";
    for (int32_t i = 0; i < e->ChildCount(); ++i) out += "{" + Describe(e->GetChild(i)) + "}";
    return out;
}

int Depth(const XmlElement& e) {
    int deepest = 0;
    for (int32_t i = 0; i < e.ChildCount(); ++i) deepest = std::max(deepest, Depth(*e.GetChild(i)));
    return deepest + 1;
}

TEST(XmlReader, BuildsTheTreeThatTheFileDescribes) {
    const std::string fits(1023, 'n'), too_long(1024, 'n');
    const struct {
        std::string input, tree;
    } cases[] = {
        {"<?xml version=\"1.0\"?><!-- c --><a v=\"1\">\n <b e=\"t\">\n  <c f=\"/x\"/>\n </b>\n</a>",
         "{a[v=1]{b[e=t]{c[f=/x]}}}"},
        // "<!--->" is a whole comment, "<!-->" is not; end of file ends one.
        {"<!---><a/><!--><b/>--><c/><!-- <d/>", "{a}{c}"},
        {"<a x=\"1\" y=\"2\n&amp;\">  one   two  </a>", "{a[x=1][y=2\n&amp;](one two )}"},
        // Later text replaces earlier; names after the start tag are no attributes.
        {"<a>first<b/> c=d <c/>>second</a>", "{a(second){b}{c}}"},
        {"<a><b></c></a><d/>", "{d}"},
        {"<a x=\"1\"><b>text", "{a[x=1]{b(text)}}"},
        {"<\xC0 \xF6=\"v\"/><\xD7/><\xF7/><9/><z/>", "{\xC0[\xF6=v]}{z}"},
        // End of file ends an open string too; the text read so far is its value.
        {"<a v=\"1\"><b f=\"/x.log", "{a[v=1]{b[f=/x.log]}}"},
        {"<a x=\"", "{a[x=]}"},
        {"<a/> / <b/>", NO_DOCUMENT},
        {"<!DOCTYPE a><a/>", NO_DOCUMENT},
        {"<?x / ?><a/>", "{a}"},  // errors inside a declaration are ignored
        // The token buffer holds 1023 characters; long text is cut, not fatal.
        {"<" + fits + " x=\"" + fits + "\"/>", "{" + fits + "[x=" + fits + "]}"},
        {"<" + too_long + "/><a x=\"" + too_long + "\"/><b/>", "{b}"},
        {"<a/><b x=\"" + too_long, "{a}"},
        {"<a>  " + std::string(3000, 't') + "  <b/></a>", "{a(" + std::string(1023, 't') + "){b}}"},
    };
    for (const auto& c : cases) EXPECT_EQ(Describe(Parse(c.input).get()), c.tree);
    EXPECT_EQ(ovo::ParseXmlFile("/nonexistent/input.xml"), nullptr);
}

// Random garbage is the fuzz targets' job; nesting depth is this reader's own limit.
TEST(XmlReader, SurvivesDeepNesting) {
    std::string nested;
    for (int i = 0; i < 100000; ++i) nested += "<a>";
    std::unique_ptr<XmlElement> document = Parse(nested);
    ASSERT_NE(document, nullptr);
    // Every too deeply nested run is dropped; the last, shallower one is kept.
    ASSERT_EQ(document->ChildCount(), 1);
    EXPECT_LE(Depth(*document->GetChild(0)), ovo::XML_DEPTH_LIMIT);
}

// The lists grow in steps; every entry must survive them, in file order.
TEST(XmlReader, KeepsEveryEntryOfLongLists) {
    std::string text = "<r";
    for (int i = 0; i < 1000; ++i) text += " a" + std::to_string(i) + "=\"" + std::to_string(i) + "\"";
    text += ">";
    for (int i = 0; i < 1000; ++i) text += "<c" + std::to_string(i) + "/>";
    std::unique_ptr<XmlElement> document = Parse(text + "</r>");
    ASSERT_NE(document, nullptr);
    const XmlElement* root = document->GetChild(0);
    ASSERT_EQ(root->AttributeCount(), 1000);
    ASSERT_EQ(root->ChildCount(), 1000);
    for (int i = 0; i < 1000; ++i) {
        EXPECT_STREQ(root->GetAttribute(i)->GetValue(), std::to_string(i).c_str());
        EXPECT_STREQ(root->GetChild(i)->GetName(), ("c" + std::to_string(i)).c_str());
    }
}

TEST(XmlQuery, ResolvesPaths) {
    const std::string segment63(63, 's'), long_value(300, 'v');
    std::unique_ptr<XmlElement> document = Parse(
        "<duoscope><debris/><debug enabled=\"no\" enable=\"true\"><output filename=\"/x.log\"/></debug></duoscope>"
        "<a x=\"outer\"><a x=\"inner\"/><b x=\"first\"/><b x=\"second\"/></a>"
        "<c:d e:f=\"colon\"/><" + segment63 + " v=\"" + long_value + "\"/>");
    ASSERT_NE(document, nullptr);
    const std::pair<std::string, std::string> cases[] = {
        {"duoscope::debug:$enable", "true"},
        {"duoscope::missing::output:$filename", ""},
        {"duoscope::debug:$missing", ""},
        // Only a name's first element is reachable; a segment naming the current one stays.
        {"a::b:$x", "first"},
        {"a::a::a:$x", "outer"},
        {"c:d:$e:f", "colon"},
        {segment63 + ":$v", long_value.substr(0, 255)},
        {segment63 + "s:$v", ""},  // cut to 63 it would name the element above
    };
    for (const auto& [path, expected] : cases) {
        EXPECT_STREQ(document->Query(path.c_str()).m_text, expected.c_str()) << path;
    }
}

const char LOG_PATH[] = "/sdcard/x.log";
const char FALLBACK_PATH[] = "/data/duoscope/debug.log";

// Stale logs that a writer must truncate, and no configuration.
void ResetDeviceFiles(bool fallback_folder = true) {
    for (const char* folder : {"/sdcard", "/data/duoscope"})
        std::filesystem::remove_all(device_files::Path(folder));
    device_files::Write(LOG_PATH, "old");
    if (fallback_folder) device_files::Write(FALLBACK_PATH, "old");
}

std::string Configuration(const std::string& root_attributes, const std::string& enable,
                          const std::string& output = "<output filename=\"/sdcard/x.log\"/>") {
    return "<?xml version=\"1.0\"?>\n<duoscope " + root_attributes + ">\n  <debug enable=\"" +
           enable + "\">" + output + "</debug>\n</duoscope>\n";
}

TEST(DebugConfig, WritesTheLogOnlyWhenSwitchedOn) {
    const std::string on = "version=\"1.0\"";
    const struct {
        std::string file;      // empty: no configuration file
        const char* log_path;  // where the lines must land; null: nowhere
    } cases[] = {
        {Configuration(on, "true"), LOG_PATH},
        {Configuration("a=\"b\" " + on, "true"), LOG_PATH},
        {Configuration(on, "true", "<output/>"), FALLBACK_PATH},
        {"", nullptr},
        {"<?xml version=\"1.0\"?>", nullptr},  // no element at all
        {Configuration("version=\"1.1\"", "true"), nullptr},
        {Configuration(on, "TRUE"), nullptr},
        {"<other " + on + "/>" + Configuration(on, "true"), nullptr},  // duoscope must come first
        {"<debug " + on + "/>" + Configuration(on, "true"), nullptr},
        {"<a/> / " + Configuration(on, "true"), nullptr},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(test.file);
        ResetDeviceFiles();
        if (!test.file.empty()) device_files::Write("/sdcard/duoscope/dconfig.xml", test.file);
        {
            ovo::DebugConfig config;
            config.Print("%04d : eye_distance(%f)", 7, 1.5);
            config.Print("|%s", "next");
        }
        const std::string lines = "0007 : eye_distance(1.500000)|next";
        EXPECT_EQ(device_files::Read(LOG_PATH), test.log_path == LOG_PATH ? lines : "old");
        EXPECT_EQ(device_files::Read(FALLBACK_PATH), test.log_path == FALLBACK_PATH ? lines : "old");
    }
}

using ovo::DebugLog;
using VPrint = void (DebugLog::*)(const char*, va_list);
// Null stands for VPrintTagged.
const VPrint EVERY_VPRINT[] = {&DebugLog::VPrint0, &DebugLog::VPrint1, &DebugLog::VPrint2,
                               &DebugLog::VPrint3, nullptr};

void Call(DebugLog& log, VPrint operation, ...) {
    va_list arguments;
    va_start(arguments, operation);
    operation ? (log.*operation)("%d;", arguments) : log.VPrintTagged("[tag] ", "%d;", arguments);
    va_end(arguments);
}

TEST(FileDebugLog, WritesToTheFileOrTheFallbackOrNowhere) {
    const char* missing = "/sdcard/missing/x.log";
    const std::string text = "5;5;5;5;[tag] 5;%d";
    const struct {
        const char* path;
        bool fallback_folder;
        std::string log, fallback;  // the files' content afterwards
        std::string opens;  // one per open line: 'o' a stream, '0' none
    } cases[] = {{LOG_PATH, true, text, "old", "o"}, {missing, true, "old", text, "0o"},
                 {missing, false, "old", "<missing>", "00"}};
    for (const auto& test : cases) {
        ResetDeviceFiles(test.fallback_folder);
        testing::internal::CaptureStderr();
        std::unique_ptr<DebugLog> log(new ovo::FileDebugLog(test.path));
        const std::string lines = std::regex_replace(testing::internal::GetCapturedStderr(),
                                                     std::regex("stream\\(0x(?!00000000)[0-9a-f]{8}\\)"), "stream(ok)");
        std::string expected;
        for (size_t i = 0; i < test.opens.size(); ++i) {
            expected += std::string("I/ZVT: stream(") + (test.opens[i] == 'o' ? "ok" : "0x00000000") +
                        ") = fopen(path=" + device_files::Path(i == 0 ? test.path : FALLBACK_PATH) + ", attrib=wt)\n\n";
        }
        EXPECT_EQ(lines, expected);
        for (VPrint operation : EVERY_VPRINT) Call(*log, operation, 5);
        log->Write("%d");
        log.reset();  // closes the file, which flushes it
        EXPECT_EQ(device_files::Read(LOG_PATH), test.log) << test.path;
        EXPECT_EQ(device_files::Read(FALLBACK_PATH, "<missing>"), test.fallback) << test.path;
    }
}

const char LINE[] = "0007 : eye_distance(1.5)";
// A library that blocks in open or read is stopped after this long, and the case fails.
constexpr unsigned HANG_SECONDS = 5;

// One of the library's files and one use of it by the library.
struct LibraryFile {
    const char* m_device_path;
    // What the other end of a FIFO offers: a file that would change what the library does
    // if it were read. Empty for the files that the library writes.
    std::string m_offered;
    // Uses the file as the library does; true when that went as it goes without the file.
    std::function<bool()> m_behaves_as_missing;
};

const LibraryFile FILES[] = {
    {ovo::PROFILE_PATH, device_files::ProfileFile({{0x2301, {1}}, {0x2403, {1}}}),
     [] { return !ovo::StereoProfile().m_enabled; }},
    {ovo::DEBUG_CONFIG_PATH, Configuration("version=\"1.0\"", "true"),
     [] {
         ovo::DebugConfig().Print("%s", LINE);
         return device_files::Read(LOG_PATH) == "old" && device_files::Read(FALLBACK_PATH) == "old";
     }},
    // A log path that is no file is one that cannot be opened: the fallback takes the lines.
    {LOG_PATH, "",
     [] {
         ovo::FileDebugLog(LOG_PATH).Write(LINE);
         return device_files::Read(FALLBACK_PATH) == LINE;
     }},
    {FALLBACK_PATH, "", [] { ovo::FileDebugLog("/sdcard/missing/x.log").Write(LINE); return true; }},
    {ovo::LIVE_TUNING_PATH, "1 2 3 4 5\n",
     [] {
         ovo::StereoProfile profile;
         profile.m_eye_distance = profile.m_ramp_steps = 9.0f;
         ovo::ReadLiveTuning(profile);
         return profile.m_eye_distance == 9.0f && profile.m_ramp_steps == 9.0f;
     }},
    {ovo::VERSION_REPORT_PATH, "",
     [] {
         ovo::VersionReport report(nullptr);
         report.SetPackageName("com.example.game");
         report.Write();
         return true;
     }},
};

enum NodeKind { FIFO_ALONE, FIFO_WITH_PEER, DIRECTORY, TERMINAL, NULL_DEVICE };
const char* const NODE_NAMES[] = {"a FIFO without a peer", "a FIFO with a peer", "a directory",
                                  "a terminal", "a link to /dev/null"};

// The node at a file's path, and our end of it when it has one.
class Node {
public:
    Node(NodeKind kind, const std::string& path, const std::string& offered) : m_end(-1) {
        std::filesystem::create_directories(std::filesystem::path(path).parent_path());
        switch (kind) {
            case FIFO_ALONE:
            case FIFO_WITH_PEER:
                EXPECT_EQ(mkfifo(path.c_str(), 0600), 0);
                // Read and write: a FIFO opened so never blocks, and is its own peer.
                if (kind == FIFO_WITH_PEER) m_end = open(path.c_str(), O_RDWR | O_NONBLOCK);
                if (m_end >= 0 && !offered.empty()) {
                    EXPECT_EQ(write(m_end, offered.data(), offered.size()), ssize_t(offered.size()));
                }
                break;
            case DIRECTORY:
                std::filesystem::create_directories(path);
                break;
            case TERMINAL:
                // A pseudo-terminal: a character device anyone may make, whose reads block
                // and whose writes arrive at our end.
                m_end = posix_openpt(O_RDWR | O_NOCTTY | O_NONBLOCK);
                EXPECT_GE(m_end, 0);
                EXPECT_TRUE(m_end >= 0 && grantpt(m_end) == 0 && unlockpt(m_end) == 0);
                EXPECT_EQ(symlink(m_end >= 0 ? ptsname(m_end) : "/dev/null", path.c_str()), 0);
                break;
            case NULL_DEVICE:
                EXPECT_EQ(symlink("/dev/null", path.c_str()), 0);
                break;
        }
    }
    ~Node() {
        if (m_end >= 0) close(m_end);
    }

    // Everything waiting at our end.
    std::string Pending() const {
        std::string bytes;
        char chunk[256];
        for (ssize_t got; m_end >= 0 && (got = read(m_end, chunk, sizeof(chunk))) > 0;) bytes.append(chunk, size_t(got));
        return bytes;
    }

private:
    int m_end;
};

enum Outcome { AS_MISSING, NOT_AS_MISSING, HUNG };

// Runs `use` in a child process that is stopped when it blocks.
Outcome RunGuarded(const std::function<bool()>& use) {
    const pid_t child = fork();
    if (child == 0) {
        alarm(HANG_SECONDS);
        _exit(use() ? 0 : 1);
    }
    int status = 0;
    while (waitpid(child, &status, 0) < 0 && errno == EINTR) {
    }
    if (WIFSIGNALED(status) && WTERMSIG(status) == SIGALRM) return HUNG;
    return WIFEXITED(status) && WEXITSTATUS(status) == 0 ? AS_MISSING : NOT_AS_MISSING;
}

TEST(LibraryFiles, AnythingButARegularFileCountsAsMissing) {
    for (const LibraryFile& file : FILES) {
        for (NodeKind kind : {FIFO_ALONE, FIFO_WITH_PEER, DIRECTORY, TERMINAL, NULL_DEVICE}) {
            SCOPED_TRACE(std::string(file.m_device_path) + " is " + NODE_NAMES[kind]);
            ResetDeviceFiles();
            std::filesystem::remove(device_files::Path(file.m_device_path));
            const Node node(kind, device_files::Path(file.m_device_path), file.m_offered);

            EXPECT_EQ(RunGuarded(file.m_behaves_as_missing), AS_MISSING);
            // Nothing taken from a peer, nothing written to it.
            EXPECT_EQ(node.Pending(), kind == FIFO_WITH_PEER ? file.m_offered : "");
        }
    }
}

}  // namespace
