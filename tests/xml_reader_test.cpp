#include "dpxlsx/readers/xml/xml_reader.h"

#include <bit>
#include <clocale>
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <random>

#include <gmock/gmock.h>
#include <libxml/xmlreader.h>

#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/xml/cm_xml_cast.h"
#include "testkit/process_settings.h"
#include "testkit/workspace.h"
#include "tests/case_table.h"
#include "tests/temporary_files.h"

namespace {

class XmlReading : public TemporaryFiles {
  protected:
    void open(XmlReader& reader, const std::string& document) { reader.mInitialize(write("part.xml", document)); }
    // Reads the whole document; the code of the exception, or 0.
    int codeOfReading(const std::string& document) {
        try {
            XmlReader reader;
            open(reader, document);
            while (reader.readNode()) {
            }
            return 0;
        } catch (const CmXmlException& e) {
            return e.code();
        }
    }
};

TEST_F(XmlReading, GoesToElements) {
    XmlReader reader;
    open(reader, "<a>text<b><sheets x='1'/></b><sheets></sheets><c/></a>");
    EXPECT_FALSE(reader.endOfFile);
    EXPECT_TRUE(reader.mGotoElement("a"));
    EXPECT_TRUE(reader.mGotoElement("sheets")) << "at any depth";
    int x = 0;
    EXPECT_TRUE(reader.mReadAttribute(x, "x"));
    EXPECT_EQ(x, 1);
    xmlTextReaderMoveToElement(reader.textReader);
    EXPECT_TRUE(reader.mGotoElement("sheets")) << "stays on the element";
    EXPECT_EQ(xmlTextReaderHasAttributes(reader.textReader), 1);
    reader.readToElement();
    reader.readNode();
    EXPECT_EQ(reader.nodeType(), XML_READER_TYPE_END_ELEMENT);
    EXPECT_TRUE(reader.mGotoElement("sheets")) << "an end tag has the name as well";
    EXPECT_FALSE(reader.mGotoElement("Sheets")) << "letter case counts";
    EXPECT_TRUE(reader.endOfFile);
}

TEST_F(XmlReading, FindsElementsOfAList) {
    XmlReader reader;
    open(reader, "<a><Row/><x><Cell/></x>text</a>");
    using dp::xml::mReadForElements;
    EXPECT_EQ(mReadForElements(reader, {}), -1);
    EXPECT_STREQ(reader.nodeName(), "a") << "did not move";
    EXPECT_EQ(mReadForElements(reader, {"Row", "Cell"}), 0);
    EXPECT_EQ(mReadForElements(reader, {"Cell", "Row"}), 1) << "stays where it is";
    EXPECT_EQ(mReadForElements(reader, {"Cell"}), 0);
    EXPECT_EQ(mReadForElements(reader, {"Row"}), -1);
    EXPECT_TRUE(reader.endOfFile);
}

TEST_F(XmlReading, ReadsIntegerAttributes) {
    for (const auto& c : caseTable("integer_attributes.txt")) {
        SCOPED_TRACE(c[0]);
        XmlReader reader;
        open(reader, "<a x='" + c[1] + "'/>");
        int value = 5;
        unsigned unsignedValue = 5;
        EXPECT_FALSE(reader.mReadAttribute(value, "y"));
        EXPECT_TRUE(reader.mReadAttribute_NotSafe(value, "x"));
        EXPECT_TRUE(reader.mReadAttribute(value, "x"));
        EXPECT_TRUE(reader.mReadAttribute(unsignedValue, "x"));
        EXPECT_EQ(std::to_string(value) + " " + std::to_string(unsignedValue), c[2] + " " + c[3]);
    }
}

TEST_F(XmlReading, FailsWithOneCodeOrNotAtAll) {
    const auto times = [](int count, const std::string& text) {
        std::string all;
        for (; count > 0; --count) all += text;
        return all;
    };
    const auto nested = [&times](int depth) { return times(depth, "<a>") + times(depth, "</a>"); };
    write("secret.txt", "secret");
    const std::string external = "<!DOCTYPE a [<!ENTITY e SYSTEM '" + file("secret.txt") + "'>]><a>&e;</a>";
    const std::string bomb =
        "<!DOCTYPE a [<!ENTITY a \"ha\"><!ENTITY b \"&a;&a;&a;&a;&a;&a;&a;&a;\">"
        "<!ENTITY c \"&b;&b;&b;&b;&b;&b;&b;&b;\"><!ENTITY d \"&c;&c;&c;&c;&c;&c;&c;&c;\">]>"
        "<a>&d;&d;&d;&d;</a>";
    const auto framed = [](const std::string& frame, const std::string& content) {
        const std::size_t place = frame.find('@');
        return frame.substr(0, place) + content + frame.substr(place + 1);
    };
    const auto repeated = [&framed](int count, const std::string& text, const std::string& frame) {
        std::string all;
        for (; count > 0; --count) all += text + std::to_string(count) + "='' ";
        return framed(frame, all);
    };
    const auto sized = [&framed](std::size_t size, const std::string& frame) {
        return framed(frame, std::string(size, 'x'));
    };
    // Nearly as long as markup may be; all of it looks like attributes and like ends of comments.
    const auto marked = [&repeated](const std::string& frame) { return repeated(14'000, "<b c=\"--", frame); };
    const std::string japanese = "<?xml version='1.0' encoding='ISO-2022-JP'?>";
    const std::string western = "<?xml version='1.0' encoding='windows-1252'?>";
    const struct {
        const char* name;
        std::string document;
        int code;
    } cases[] = {{"empty", "", 13},
                 {"no XML", "PK", 13},
                 {"cut in half", "<a><b>text</b><b>te", 13},
                 {"well-formed", "<a><b>text</b></a>", 0},
                 {"deep", nested(dp::kXmlDepth + 1), 13},
                 {"less deep", nested(dp::kXmlDepth), 0},
                 {"external entity", external, 0},
                 {"nested entities", bomb, 13},
                 {"12 MB of text", sized(12'000'000, "<a>@</a>"), 13},
                 {"9 MB of text", sized(9'000'000, "<a>@</a>"), 0},
                 {"9 MB of text in another encoding",
                  sized(9'000'000, "<?xml version='1.0' encoding='windows-1252'?><a>@\xE9</a>"), 0},
                 {"a long attribute", sized(dp::kMarkupSize - 10'000, "<a b='@'/>"), 0},
                 {"an attribute too long", sized(dp::kMarkupSize + 10'000, "<a b='@'/>"), 13},
                 {"a comment too long", sized(dp::kMarkupSize + 10'000, "<a><!--@--></a>"), 13},
                 {"many attributes", repeated(1000, "b", "<a @/>"), 0},
                 {"too many attributes", repeated(10'000, "b", "<a @/>"), 13},
                 {"many comments", framed("<a>@</a>", times(2'000'000, "<!--x-->")), 13},
                 {"too many marks in a comment", repeated(9'000, "b", "<a><!--@--></a>"), 13},
                 {"marks in a CDATA section", marked("<a><![CDATA[@]]></a>"), 0},
                 {"marks in one of another encoding", marked(western + "<a><![CDATA[@]]></a>"), 0},
                 {"marks in one behind odd markup",
                  marked("<!DOCTYPE a [<!--'-->]><a b='>'><!-->--><?c '?><!--'--><![CDATA[@]]></a>"), 0},
                 {"a CDATA section in front of attributes", repeated(9'000, "b", "<a><![CDATA[]]><b @/></a>"), 13},
                 {"marks in one, and in attributes behind it",
                  marked("<a><![CDATA[@]]>") + repeated(9'000, "b", "<b @/></a>"), 13},
                 {"one in a comment", repeated(9'000, "b", "<a><!--<![CDATA[--><b @/></a>"), 13},
                 {"one in an instruction", repeated(9'000, "b", "<a><?c <![CDATA[?><b @/></a>"), 13},
                 {"one by its bytes", repeated(9'000, "b", japanese + "<a>\x1B$B<![CDATA[x\x1B(B<b @/></a>"), 13},
                 {"marks in one of bytes decoded", marked(japanese + "<a>\x1B$B!!\x1B(B<![CDATA[@]]></a>"), 0},
                 {"bytes that are no character", sized(10'000, western + "<a>@<b>\x81</b></a>"), 13},
                 {"an entity", "<!DOCTYPE a [<!ENTITY e 'x'>]><a b='&e;'/>", 13},
                 {"declared attributes", "<!DOCTYPE a [<!ATTLIST a b IDREF #IMPLIED>]><a b='c'/>", 13},
                 {"a compressed document",
                  {"\x1F\x8B\x08\0\0\0\0\0\x02\x03\xB3\x49\xD4\xB7\x03\0\xD4\x1C\xD1\x01\x04\0\0\0", 24},
                  13}};
    int reports = 0;
    const auto report = [](void* count, auto) { ++*static_cast<int*>(count); };
    xmlSetStructuredErrorFunc(&reports, report);
    testing::internal::CaptureStderr();
    for (const auto& c : cases) EXPECT_EQ(codeOfReading(c.document), c.code) << c.name;
    EXPECT_THROW(XmlReader().mInitialize(file("nowhere.xml")), CmXmlException);
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "") << "nothing is printed";
    EXPECT_EQ(reports, 0) << "nothing is reported either";
    EXPECT_EQ(xmlStructuredErrorContext, &reports) << "and the host's handler is still there";
    xmlSetStructuredErrorFunc(nullptr, nullptr);

    XmlReader reader;
    open(reader, external);
    std::string text;
    while (reader.readNode())
        if (reader.nodeType() == XML_READER_TYPE_TEXT) text += reader.nodeValue();
    EXPECT_EQ(text, "") << "external entities are not fetched";
}

TEST_F(XmlReading, DecodesAlikeWithEveryLibxml2) {
    const auto declaring = [](const std::string& encoding, const std::string& rest) {
        return "<?xml version='1.0' encoding='" + encoding + "'?><a>" + rest;
    };
    const auto widened = [](const std::string& text, std::size_t before, std::size_t behind) {
        std::string wide;
        for (const char c : text) wide += std::string(before, '\0') + c + std::string(behind, '\0');
        return wide;
    };
    const auto times = [](int count, const std::string& text) {
        std::string all;
        for (; count > 0; --count) all += text;
        return all;
    };
    const std::string refused = "refused";
    const std::string ebcdic =  // <?xml version='1.0' encoding='IBM500'?><a>!</a>
        "\x4C\x6F\xA7\x94\x93\x40\xA5\x85\x99\xA2\x89\x96\x95\x7E\x7D\xF1\x4B\xF0\x7D\x40\x85\x95\x83\x96\x84\x89\x95"
        "\x87"
        "\x7E\x7D\xC9\xC2\xD4\xF5\xF0\xF0\x7D\x6F\x6E\x4C\x81\x6E\x4F\x4C\x61\x81\x6E";
    const struct {
        const char* name;
        std::string document;
        std::string text;
    } cases[] = {
        {"undefined", declaring("windows-1252", "\x81</a>"), refused},
        {"undefined, behind it all", declaring("windows-1252", "</a>\x81"), refused},
        {"half a character at the end", declaring("Shift_JIS", "</a>\x81"), refused},
        {"half of one before the buffer's end", declaring("Shift_JIS", times(40'000, "\x93\xFA") + "</a>"),
         times(40'000, "\u65E5")},
        {"the other half", declaring("Shift_JIS", "x" + times(40'000, "\x93\xFA") + "</a>"),
         "x" + times(40'000, "\u65E5")},
        {"kept back by the decoder", declaring("windows-1258", "a\xEC</a>"), "\u00E1"},
        {"in small letters, without a hyphen", declaring("iso8859-15", "\xA4</a>"), "\u20AC"},
        {"libxml2's own name", declaring("ISO-LATIN-2", "\xB1</a>"), "\u0105"},
        {"unknown", declaring("unknown", "x</a>"), refused},
        {"with instructions for iconv", declaring("US-ASCII//IGNORE", "x\x81</a>"), refused},
        {"against its mark", "\xEF\xBB\xBF" + declaring("ISO-8859-1", "\xE9</a>"), "\u00E9"},
        {"UTF-16", "\xFF\xFE" + widened(declaring("UTF-16", "x</a>"), 0, 1), "x"},
        {"UTF-16, undeclared", "\xFE\xFF" + widened("<a>x</a>", 1, 0), "x"},
        {"UTF-16 without a mark", widened(declaring("UTF-16", "x</a>"), 1, 0), "x"},
        {"UTF-16 that declares something else", widened(declaring("IBM500", "x</a>"), 0, 1), "x"},
        {"UTF-32", widened(declaring("UTF-32", "x</a>"), 0, 3), "x"},
        {"half a surrogate pair", "\xFF\xFE" + widened("<a>", 0, 1) + "\x3D\xD8" + widened("</a>", 0, 1), refused},
        {"EBCDIC", ebcdic, "!"}};
    for (const auto& c : cases) {
        std::string text;
        try {
            XmlReader reader;
            open(reader, c.document);
            while (reader.readNode())
                if (reader.nodeType() == XML_READER_TYPE_TEXT) text += reader.nodeValue();
        } catch (const CmXmlException&) {
            text = refused;
        }
        EXPECT_EQ(text, c.text) << c.name;
    }
}

// Each name with a prefix is added to libxml2's dictionary when it is asked for; the dictionary takes 50 MB at most.
TEST_F(XmlReading, FailsWhereNoNameCanBeMade) {
    const std::string filler(5000, 'n');
    std::string document = "<a";
    for (int i = 0; i < 20; ++i) document += " xmlns:p" + std::to_string(i) + filler + "='u'";
    document += ">";
    for (int i = 0; i < 5500; ++i)
        document += "<p" + std::to_string(i % 20) + filler + ":l" + std::to_string(i / 20) + filler + "/>";
    EXPECT_EQ(codeOfReading(document + "</a>"), 0) << "nobody asks for names";
    XmlReader reader;
    open(reader, document + "</a>");
    // Without its name an element would be skipped, with all its content.
    EXPECT_THROW(while (reader.readToElement()) if (!reader.nodeName()) break, CmXmlException);
}

TEST_F(XmlReading, LeavesAHostThatMovesOnItsOwnAlone) {
    std::string document = "<a>";
    while (document.size() < dp::kRunSize + 1'000'000) document += "<b c='" + std::string(1000, 'x') + "'/>";
    XmlReader reader;
    open(reader, document + "</a>");
    int result = 1;
    while (result == 1) result = xmlTextReaderRead(reader.textReader);
    EXPECT_EQ(result, 0) << "the end, not a limit";

    // The host's error handlers have been restored.
    int context = 0;
    xmlSetGenericErrorFunc(&context, nullptr);
    xmlSetStructuredErrorFunc(&context, [](auto...) {});
    EXPECT_EQ(codeOfReading("no XML"), 13);
    EXPECT_TRUE(xmlGenericErrorContext == &context && xmlStructuredErrorContext == &context && xmlStructuredError);
    xmlSetGenericErrorFunc(nullptr, nullptr);
    xmlSetStructuredErrorFunc(nullptr, nullptr);
}

TEST_F(XmlReading, ReadsAPrivateCopyWhereLibxml2CannotOpenThePath) {
    XmlReader direct;
    write("a:/part.xml", "<a><b/></a>");
    direct.mInitialize(files().string() + "/a://part.xml");
    EXPECT_FALSE(direct.tempCopy) << "an absolute path is no address";
    // A relative path to the file system, but an address of another file to libxml2.
    const std::string path = "file:///nowhere/part.xml";
    write(path, "<a><b/></a>");
    boost::filesystem::current_path(files());
    {
        XmlReader reader;
        reader.mInitialize(path);
        EXPECT_TRUE(reader.tempCopy);
        const boost::filesystem::path copy(reader.tempPath);
        EXPECT_TRUE(boost::filesystem::exists(copy));
        EXPECT_EQ(copy.parent_path(), temporary());
        EXPECT_THAT(copy.filename().string(), testing::MatchesRegex("[0-9a-f]{4}-[0-9a-f]{4}"));
        EXPECT_TRUE(reader.mGotoElement("b"));
    }
    EXPECT_TRUE(boost::filesystem::is_empty(temporary()));
    boost::filesystem::current_path(workingDirectory());
}

// The result that the conversion is defined to have under the process's locale.
double castLiterally(const std::string& text) {
    std::string copy = text;
    const char point = *std::localeconv()->decimal_point;
    if (const auto last = copy.rfind('.'); point != '.' && last != copy.npos) copy[last] = point;
    return std::atof(copy.c_str());
}

void compareCasts(unsigned count, unsigned seed) {
    std::mt19937 random(seed);
    const std::string alphabet = "0123456789.-+eE, x";
    char text[64];
    for (unsigned i = 0; i < count; ++i) {
        if (i % 4 == 0) {  // any text over the alphabet of numbers
            std::size_t length = random() % 10;
            text[length] = '\0';
            while (length > 0) text[--length] = alphabet[random() % alphabet.size()];
        } else {
            const double value = std::ldexp(static_cast<double>(random()), static_cast<int>(random() % 200) - 100);
            std::snprintf(text, sizeof text, i % 4 == 1 ? "%.17g" : i % 4 == 2 ? "%.6f" : "%.3e", value);
            if (char* comma = std::strchr(text, ',')) *comma = '.';
        }
        double value = -1.0;
        CmXmlCast::instance().mCast(value, text);
        ASSERT_EQ(value, castLiterally(text)) << '"' << text << '"';
    }
}

TEST(CmXmlCast, YieldsWhatTheCLibraryYields) {
    for (const char* text : {"", "abc", "  7", "+7", "0x1A", "1e999", "-1e-999", "12 kg", "1e5x", ".", "-", "-.5", "5.",
                             "1.2.3", "\t-3.25\n", "4e-320", "-0.0"}) {
        double value = -1.0;
        CmXmlCast::instance().mCast(value, text);
        EXPECT_EQ(std::bit_cast<std::uint64_t>(value), std::bit_cast<std::uint64_t>(castLiterally(text))) << text;
    }
    compareCasts(200'000, 1);
    EXPECT_NE(CmXmlCast::m_pInstance, nullptr);
}

TEST(CmXmlCast, ReadsPointsUnderADecimalComma) {
    const testkit::Workspace workspace;
    const auto directory = workspace.files();
    const std::string make = "localedef -i de_DE -f UTF-8 " + (directory / "de_DE.UTF-8").string() + " >/dev/null 2>&1";
    const bool made = std::system(make.c_str()) == 0;
    const testkit::EnvironmentVariable locales("LOCPATH", directory.string());
    if (!made || !std::setlocale(LC_ALL, "de_DE.UTF-8"))
        GTEST_SKIP() << "no locale with a decimal comma can be made here";
    double value = 0;
    CmXmlCast::instance().mCast(value, "1.5");
    EXPECT_EQ(value, 1.5);
    CmXmlCast::instance().mCast(value, "1.234.5");
    EXPECT_EQ(value, 1.0) << "only the last point is a decimal comma";
    compareCasts(50'000, 2);
    std::setlocale(LC_ALL, "C");
}

}  // namespace
