#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <memory>
#include <string>

#include "config/xml_reader.h"

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

}  // namespace
