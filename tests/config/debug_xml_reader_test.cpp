#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <random>
#include <string>

#include "config/xml_reader.h"
#include "debug_test_files.h"

namespace {

using ovo::XmlElement;

const char NO_DOCUMENT[] = "<no document>";

std::unique_ptr<XmlElement> Parse(const std::string& text) {
    WriteDeviceFile("/tmp/xml/input.xml", text);
    return std::unique_ptr<XmlElement>(ovo::ParseXmlFile(RootPath("/tmp/xml/input.xml").c_str()));
}

// name[attr=value,...](text){child child}; a document lists its top-level elements.
std::string Describe(const XmlElement& element) {
    bool document = element.GetName() == nullptr;
    std::string out = document ? "" : element.GetName();
    for (int32_t i = 0; i < element.AttributeCount(); ++i) {
        out += std::string(i == 0 ? "[" : ",") + element.GetAttribute(i)->GetName() + "=" +
               element.GetAttribute(i)->GetValue() + (i + 1 == element.AttributeCount() ? "]" : "");
    }
    if (element.GetValue() != nullptr) out += std::string("(") + element.GetValue() + ")";
    for (int32_t i = 0; i < element.ChildCount(); ++i) {
        out += (i > 0 ? " " : document ? "" : "{") + Describe(*element.GetChild(i));
    }
    return out + (element.ChildCount() > 0 && !document ? "}" : "");
}

std::string Outcome(const std::string& text) {
    std::unique_ptr<XmlElement> document = Parse(text);
    return document == nullptr ? NO_DOCUMENT : Describe(*document);
}

int Depth(const XmlElement& element) {
    int deepest = 0;
    for (int32_t i = 0; i < element.ChildCount(); ++i) {
        deepest = std::max(deepest, Depth(*element.GetChild(i)));
    }
    return deepest + 1;
}

struct ReaderCase {
    const char* what;
    std::string input;
    std::string tree;
};

TEST(XmlReader, BuildsTheTreeThatTheFileDescribes) {
    const std::string config =
        "<duoscope version=\"1.0\">\n  <debug enable=\"true\">\n"
        "    <output filename=\"/sdcard/x.log\"/>\n  </debug>\n</duoscope>\n";
    const char* config_tree = "duoscope[version=1.0]{debug[enable=true]{output[filename=/sdcard/x.log]}}";
    const ReaderCase cases[] = {
        {"plain configuration", config, config_tree},
        {"declaration and comments are invisible",
         "<?xml version=\"1.0\"?>\n<!-- switch -->" + config + "<!-- end -->", config_tree},
        {"<!---> is a whole comment", "<!---><a/>", "a"},
        {"<!--> is not", "<!--><a/>--><b/>", "b"},
        {"white space folded", "<a>  one   two  </a>", "a(one two )"},
        {"attributes in file order", "<a x=\"1\" y=\"2\"/>", "a[x=1,y=2]"},
        {"string spans lines, keeps entities", "<a x=\"1\n&amp;\"/>", "a[x=1\n&amp;]"},
        {"later text replaces earlier", "<a>first<b/>>second</a>", "a(second){b}"},
        {"names after the start tag are ignored", "<a>t<b/> c=d <c/></a>", "a(t){b c}"},
        {"single quotes delimit nothing", "<a x='1'/><b/>", "b"},
        {"mismatched close tag drops the element", "<a><b></c></a><d/>", "d"},
        {"end of file keeps what was read", "<a x=\"1\"><b>text", "a[x=1]{b(text)}"},
        {"unterminated comment ends the file", "<a/><!-- <b/>", "a"},
        {"Latin-1 name start bytes", "<\xC0\xD6 \xF6x=\"v\"/>", "\xC0\xD6[\xF6x=v]"},
        {"other bytes start no name", "<\xD7/><\xF7/><9/><z/>", "z"},
        {"unterminated string inside an element", "<a x=\"1", ""},
        {"stray slash between elements", "<a/> / <b/>", NO_DOCUMENT},
        {"<! without --", "<!DOCTYPE a><a/>", NO_DOCUMENT},
        {"unterminated string between elements", "<a/>\"<b/>", NO_DOCUMENT},
        {"token error inside a declaration", "<? / ?><a/>", "a"},
        {"empty file", "", ""},
    };
    for (const ReaderCase& test : cases) {
        EXPECT_EQ(Outcome(test.input), test.tree) << test.what;
    }
    RemoveDeviceTrees({"/tmp/xml"});
    EXPECT_EQ(ovo::ParseXmlFile(RootPath("/tmp/xml/input.xml").c_str()), nullptr);
}

TEST(XmlReader, StaysWithinItsTokenBuffer) {
    const std::string fits(1023, 'n');
    const std::string too_long(1024, 'n');
    const ReaderCase cases[] = {
        {"name of 1023", "<" + fits + "/>", fits},
        {"name of 1024", "<" + too_long + "/><b/>", "b"},
        {"value of 1023", "<a x=\"" + fits + "\"/>", "a[x=" + fits + "]"},
        {"value of 1024", "<a x=\"" + too_long + "\"/><b/>", "b"},
        {"value of 1024 between elements", "\"" + too_long + "\"<b/>", NO_DOCUMENT},
        // Long text is cut, not fatal: the element and what follows it survive.
        {"text of 3000", "<a>  " + std::string(3000, 't') + "  <b/></a>",
         "a(" + std::string(1023, 't') + "){b}"},
    };
    for (const ReaderCase& test : cases) {
        EXPECT_EQ(Outcome(test.input), test.tree) << test.what;
    }
}

TEST(XmlReader, SurvivesDeepNestingAndGarbage) {
    std::string nested;
    for (int i = 0; i < 100000; ++i) nested += "<a>";
    std::unique_ptr<XmlElement> document = Parse(nested);
    ASSERT_NE(document, nullptr);
    // Every too deeply nested run is dropped; the last, shallower one is kept.
    ASSERT_EQ(document->ChildCount(), 1);
    EXPECT_LE(Depth(*document->GetChild(0)), ovo::XML_DEPTH_LIMIT);

    std::mt19937 random(20240601);
    const char steering[] = "<>/?!-=\"abc: \n\xC3\xFF";
    for (int round = 0; round < 200; ++round) {
        std::string input(1 + random() % 4096, '\0');
        for (char& c : input) {
            c = random() % 2 ? static_cast<char>(random()) : steering[random() % (sizeof(steering) - 1)];
        }
        document = Parse(input);
        if (document != nullptr) {
            EXPECT_LE(Depth(*document), ovo::XML_DEPTH_LIMIT + 1);
        }
    }
}

}  // namespace
