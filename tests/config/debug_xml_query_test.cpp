#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "config/xml_reader.h"
#include "debug_test_files.h"

namespace {

TEST(XmlQuery, ResolvesPaths) {
    const std::string segment63(63, 's');
    const std::string long_value(300, 'v');
    WriteDeviceFile("/tmp/xml/query.xml",
                    "<duoscope version=\"1.0\"><debug enable=\"true\" empty=\"\">"
                    "<output filename=\"/sdcard/x.log\"/></debug></duoscope>"
                    "<a x=\"outer\"><a x=\"inner\"/><b x=\"first\"/><b x=\"second\"/></a>"
                    "<c:d e:f=\"colon\"/><" + segment63 + " v=\"" + long_value + "\"/>");
    std::unique_ptr<ovo::XmlElement> document(
        ovo::ParseXmlFile(RootPath("/tmp/xml/query.xml").c_str()));
    ASSERT_NE(document, nullptr);
    ovo::XmlElement* a = document->GetChild(1);
    const std::string path63 = segment63 + ":$v";
    const std::string path64 = segment63 + "s:$v";
    const struct {
        ovo::XmlElement* start;
        std::string path;
        std::string expected;
    } cases[] = {
        {document.get(), "duoscope::debug:$enable", "true"},
        {document.get(), "duoscope::debug::output:$filename", "/sdcard/x.log"},
        {document.get(), "duoscope::debug::output::filename", "/sdcard/x.log"},
        {document.get(), "duoscope::debug:$empty", ""},
        {document.get(), "duoscope::missing::output:$filename", ""},
        {document.get(), "duoscope::debug:$missing", ""},
        // Only the first element of a name is reachable, and a segment naming the
        // current element stays on it.
        {document.get(), "a::b:$x", "first"},
        {document.get(), "a::a::a:$x", "outer"},
        {a, "a:$x", "outer"},
        {a, "b:$x", "first"},
        {document.get(), "c:d:$e:f", "colon"},
        {document.get(), "a:", ""},
        {document.get(), "", ""},
        {document.get(), path63, long_value.substr(0, 255)},
        {document.get(), path64, ""},  // cut to 63 it would name the element above
    };
    for (const auto& test : cases) {
        EXPECT_EQ(std::string(test.start->Query(test.path.c_str()).m_text), test.expected) << test.path;
    }
}

}  // namespace
