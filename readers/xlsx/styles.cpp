#include <cstdint>
#include <iterator>
#include <string_view>
#include <utility>

#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"

// The style sheet of a package: number formats, and which of them the cell styles use.
namespace dp {

namespace {

struct BuiltInFormat {
    const char* styleId;
    const char* formatCode;
    EXCEL_FORMAT_TYPE formatType;
};

// The code of the short date is the reader's own.
constexpr const char* kShortDate = nullptr;

constexpr BuiltInFormat kBuiltInFormats[] = {
    {"1", "0", EXCEL_FORMAT_NUMBER},
    {"2", "0.00", EXCEL_FORMAT_NUMBER},
    {"3", "#,##0", EXCEL_FORMAT_NUMBER},
    {"4", "#,##0.00", EXCEL_FORMAT_NUMBER},
    {"5", R"("$"#,##0_);\("$"#,##0\))", EXCEL_FORMAT_CURRENCY},
    {"6", R"("$"#,##0_);[Red]\("$"#,##0\))", EXCEL_FORMAT_CURRENCY},
    {"7", R"("$"#,##0.00_);\("$"#,##0.00\))", EXCEL_FORMAT_CURRENCY},
    {"8", R"("$"#,##0.00_);[Red]\("$"#,##0.00\))", EXCEL_FORMAT_CURRENCY},
    {"9", "0%", EXCEL_FORMAT_PERCENT},
    {"10", "0.00%", EXCEL_FORMAT_PERCENT},
    {"11", "0.00E+00", EXCEL_FORMAT_SCIENTIFIC},
    {"48", "0.00E+00", EXCEL_FORMAT_SCIENTIFIC},
    {"14", kShortDate, EXCEL_FORMAT_DATE},
    {"15", "d-mmm-yy", EXCEL_FORMAT_DATE},
    {"16", "d-mmm", EXCEL_FORMAT_DATE},
    {"17", "mmm-yy", EXCEL_FORMAT_DATE},
    {"18", "h:mm AM/PM", EXCEL_FORMAT_TIME},
    {"19", "h:mm:ss AM/PM", EXCEL_FORMAT_TIME},
    {"20", "h:mm", EXCEL_FORMAT_TIME},
    {"21", "h:mm:ss", EXCEL_FORMAT_TIME},
    {"22", "m/d/yy h:mm:ss", EXCEL_FORMAT_DATETIME},
    {"37", R"(#,##0_);\(#,##0\))", EXCEL_FORMAT_PARENTHESES},
    {"38", R"(#,##0_);[Red]\(#,##0\))", EXCEL_FORMAT_PARENTHESES},
    {"39", R"(#,##0.00_);\(#,##0.00\))", EXCEL_FORMAT_PARENTHESES},
    {"40", R"(#,##0.00_);[Red]\(#,##0.00\))", EXCEL_FORMAT_PARENTHESES},
    {"41", R"(_("$"* #,##0_);_("$"* \(#,##0\);_("$"* "-"_);_(@_))", EXCEL_FORMAT_CURRENCY},
    {"42", R"(_(* #,##0_);_(* \(#,##0\);_(* "-"_);_(@_))", EXCEL_FORMAT_CURRENCY},
    {"43", R"(_("$"* #,##0.00_);_("$"* \(#,##0.00\);_("$"* "-"??_);_(@_))", EXCEL_FORMAT_CURRENCY},
    {"44", R"(_("$"* #,##0.00_);_("$"* \(#,##0.00\); _("$"* "-"??_);_(@_))", EXCEL_FORMAT_CURRENCY},
    {"45", "mm:ss", EXCEL_FORMAT_TIME},
    {"46", "[h]:mm:ss", EXCEL_FORMAT_TIME},
    {"47", "mm:ss", EXCEL_FORMAT_TIME},
};

constexpr std::int64_t kBuiltInCount = std::size(kBuiltInFormats);

// Visits the elements of the style sheet and fills the two tables.
class StyleSheetPass {
  public:
    StyleSheetPass(ExcelXLSXReader& owner, XmlReader& reader, std::vector<xStyle>& styles,
                   std::vector<std::string>& cellFormats)
        : owner_(owner), reader_(reader), styles_(styles), cellFormats_(cellFormats) {}

    void visitElement() {
        const std::string_view name = reader_.nodeName();
        if (name == "xf")
            addCellFormat();
        else if (name == "numFmt")
            addNumberFormat();
        else if (name == "numFmts")
            beginNumberFormats();
        else if (name == "cellXfs")
            inCellFormats_ = true;
    }

    bool builtInsAdded() const { return builtInsAdded_; }

  private:
    void beginNumberFormats() {
        reader_.mReadAttribute(declared_, "count");
        if (declared_ <= 0) return;
        styles_.clear();
        owner_.mAddPredefined2007Styles();
        builtInsAdded_ = true;
    }

    // Keeps as many formats as were declared, beside the built-in ones, whichever elements they are
    // in.
    void addNumberFormat() {
        xStyle style;
        style.styleId = reader_.attributeText("numFmtId");
        style.formatCode = reader_.attributeText("formatCode");
        const auto size = static_cast<std::int64_t>(styles_.size());
        if (size >= std::int64_t{declared_} + kBuiltInCount) return;
        if (style.formatCode.empty() || style.formatCode.size() > kFormatCodeSize) return;
        owner_.mSetFmtType(style);
        styles_.push_back(std::move(style));
    }

    // The xf elements before cellXfs belong to named styles.
    void addCellFormat() {
        if (inCellFormats_) cellFormats_.push_back(reader_.attributeText("numFmtId"));
    }

    ExcelXLSXReader& owner_;
    XmlReader& reader_;
    std::vector<xStyle>& styles_;
    std::vector<std::string>& cellFormats_;
    int declared_ = 0;  // custom formats
    bool builtInsAdded_ = false;
    bool inCellFormats_ = false;
};

}  // namespace

void ExcelXLSXReader::mAddPredefined2007Styles() {
    for (const BuiltInFormat& format : kBuiltInFormats)
        styles.push_back({format.styleId,
                          format.formatCode ? std::string(format.formatCode) : shortDateFormat,
                          format.formatType});
}

void ExcelXLSXReader::mReadExcel2007Styles() {
    XmlReader reader;
    reader.mInitialize(xlDir + "/styles.xml");
    cellXfNumFmtIds.clear();
    StyleSheetPass pass(*this, reader, styles, cellXfNumFmtIds);
    bool more = reader.nodeType() == 1 || reader.readToElement();
    for (; more; more = reader.readToElement()) pass.visitElement();
    if (!pass.builtInsAdded()) {
        styles.clear();
        mAddPredefined2007Styles();
    }
    mReplaceDescWithFormat();
    resolveNumberKinds();
}

}  // namespace dp
