#include "dpxlsx/readers/xml/plain_xml.h"

#include <regex>
#include <string>

#include "tests/case_table.h"
#include "tests/temporary_files.h"

namespace {

class PlainXmlNodes : public TemporaryFiles {
  protected:
    using Node = dp::PlainXml::Node;

    // The nodes of a document as they would be written, each value of an attribute `a` behind the name,
    // or "!" from where it is not plain.
    std::string read(const std::string& document, dp::ReadingWindow window = {}) {
        dp::PlainXml xml(window);
        if (!xml.open(write("part.xml", document))) return "!";
        std::string nodes;
        for (Node node = xml.next(); node != Node::Finished; node = xml.next()) {
            if (node == Node::NotPlain) return nodes + "!";
            if (node == Node::Text) {
                nodes += xml.text();
                continue;
            }
            nodes += (node == Node::End ? "</" : "<") + std::string(xml.name());
            if (const char* a = node == Node::End ? nullptr : xml.attribute("a")) nodes += std::string("=") + a;
            nodes += node == Node::Empty ? "/>" : ">";
        }
        return nodes;
    }
};

// However the bytes arrive.
TEST_F(PlainXmlNodes, AreThoseOfTheDocument) {
    for (const auto& c : caseTable("plain_xml.txt"))
        for (const std::size_t step : {1U, 2U, 3U, 5U, 7U, 64U, 1U << 20})
            EXPECT_EQ(read(c[1], {dp::ReadingWindow().size, step}), c[2]) << c[0] << ", " << step << " bytes at a time";
}

// Below what libxml2 and the readers allow, a document is left to them.
TEST_F(PlainXmlNodes, AreNotReadNearALimit) {
    const auto repeated = [](const std::string& text, int times) {
        std::string all;
        for (int i = 0; i < times; ++i) all += std::regex_replace(text, std::regex("N"), std::to_string(i));
        return all;
    };
    const auto within = [](const std::string& text) { return "<r>" + text + "</r>"; };
    const struct {
        const char* name;
        std::string plain;
        std::string beyond;
    } kCases[] = {
        {"nested elements", repeated("<e>", 128) + repeated("</e>", 128), repeated("<e>", 129) + repeated("</e>", 129)},
        {"bytes of a tag", within("<e a='" + std::string(8000, 'x') + "'/>"),
         within("<e a='" + std::string(8200, 'x') + "'/>")},
        {"attributes", within("<e " + repeated("aN='' ", 48) + "/>"), within("<e " + repeated("aN='' ", 49) + "/>")},
        {"bytes of a text", within(std::string(dp::ReadingWindow().size - 8, 'x')),
         within(std::string(dp::ReadingWindow().size + 1, 'x'))},
        {"bytes of names", within(repeated("<eN/>", 60'000)), within(repeated("<elementN/>", 60'000))},
        {"bytes of blank texts", within(repeated("<e/>    ", 100'000)), ""},
    };
    for (const auto& c : kCases) {
        EXPECT_NE(read(c.plain).back(), '!') << c.name;
        if (c.beyond.empty()) continue;
        EXPECT_EQ(read(c.beyond).back(), '!') << c.name;
    }
}

}  // namespace
