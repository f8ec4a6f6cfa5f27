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
    const auto blanks = [](std::size_t bytes) { return std::string(bytes, ' '); };
    const auto nested = [](const std::string& attributes) {
        return "<r " + attributes + "><e " + std::regex_replace(attributes, std::regex("p"), "q") + "/></r>";
    };
    const std::string kDeclared = "<?xml version='1.0'?>";
    constexpr std::size_t kWindow = dp::ReadingWindow().size;
    const struct {
        const char* name;
        std::string plain;
        std::string beyond;
    } kCases[] = {
        {"nested elements", repeated("<e>", 128) + repeated("</e>", 128), repeated("<e>", 129) + repeated("</e>", 129)},
        {"bytes of a tag", within("<e a='" + std::string(8000, 'x') + "'/>"),
         within("<e a='" + std::string(8200, 'x') + "'/>")},
        {"attributes", within("<e " + repeated("aN='' ", 48) + "/>"), within("<e " + repeated("aN='' ", 49) + "/>")},
        {"bytes of an end tag", "<r></r" + std::string(8000, '\n') + ">", "<r></r" + std::string(8200, '\n') + ">"},
        {"bytes of a text", within(std::string(kWindow - 8, 'x')), within(std::string(kWindow + 1, 'x'))},
        {"white space outside the root", kDeclared + blanks(kWindow / 2) + "<r/>" + blanks(kWindow / 2),
         kDeclared + blanks(kWindow / 2) + "<r/>" + blanks(kWindow / 2 + 1)},
        {"prefixes in scope", nested(repeated("xmlns:pN='u' ", 32)), nested(repeated("xmlns:pN='u' ", 33))},
        {"bytes of namespaces", within(repeated("<e xmlns='" + std::string(80, 'u') + "N'/>", 6000)),
         within(repeated("<e xmlns='" + std::string(90, 'u') + "N'/>", 6000))},
        {"bytes of blank texts", within(repeated("<e/>    ", 100'000)), ""},
    };
    for (const auto& c : kCases) {
        EXPECT_NE(read(c.plain).back(), '!') << c.name;
        if (c.beyond.empty()) continue;
        EXPECT_EQ(read(c.beyond).back(), '!') << c.name;
    }
}

}  // namespace
