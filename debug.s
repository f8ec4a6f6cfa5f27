CreateDataProvider
GetDataProviderFiletype
IsMicrosoftXLSXFile
CmXmlException::CmXmlException(int)
CmXmlException::CmXmlException(int)
dp::CellColumn::assignRare(unsigned int, dp::ExternalDataRecordCell const&)
dp::CellColumn::put(dp::PackedCell const&)
dp::CellColumn::clear()
dp::CellColumn::texts()
dp::CellColumn::assign(unsigned int, dp::ExternalDataRecordCell const&)
dp::CellColumn::CellColumn(dp::CellColumn&&)
dp::CellColumn::CellColumn(std::shared_ptr<dp::TextPool>)
dp::CellColumn::CellColumn(dp::CellColumn&&)
dp::CellColumn::CellColumn(std::shared_ptr<dp::TextPool>)
dp::CellColumn::~CellColumn()
dp::CellColumn::~CellColumn()
dp::ColumnView::ColumnView()
dp::ColumnView::ColumnView()
dp::ColumnView::~ColumnView()
dp::ColumnView::~ColumnView()
dp::ColumnView::~ColumnView()
dp::IsDateTime(dp::IDateTimeVariableFormat const*, dp::IString const*, dp::IString*, double&)
dp::TextColumn::SetPrimeKey(int)
dp::TextColumn::SetVariableBodyPrimeKey(int)
dp::TextColumn::SetOriginalVariablePrimeKey(int)
dp::TextColumn::AddRef()
dp::TextColumn::Release()
dp::TextColumn::TextColumn()
dp::TextColumn::TextColumn()
dp::TextColumn::~TextColumn()
dp::TextColumn::~TextColumn()
dp::TextColumn::~TextColumn()
dp::excel_xlsx::GetWorksheets(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&, std::vector<std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >, std::allocator<std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > > >&)
dp::FormulaNode::SetPrimeKey(int)
dp::FormulaNode::SetChildNode(dp::IFormulaNode*)
dp::FormulaNode::SetParentNode(dp::IFormulaNode*)
dp::FormulaNode::FormulaNode(dp::FormulaNode const&)
dp::FormulaNode::FormulaNode()
dp::FormulaNode::FormulaNode(dp::FormulaNode const&)
dp::FormulaNode::FormulaNode()
dp::FormulaNode::~FormulaNode()
dp::FormulaNode::~FormulaNode()
dp::FormulaNode::~FormulaNode()
dp::FormulaNode::operator=(dp::FormulaNode const&)
dp::TEXT_FORMAT[abi:cxx11]
dp::LANG_ID_MASK[abi:cxx11]
dp::NumericColumn::SetPrimeKey(int)
dp::NumericColumn::SetVariableBodyPrimeKey(int)
dp::NumericColumn::SetOriginalVariablePrimeKey(int)
dp::NumericColumn::AddRef()
dp::NumericColumn::Release()
dp::NumericColumn::NumericColumn()
dp::NumericColumn::NumericColumn()
dp::NumericColumn::~NumericColumn()
dp::NumericColumn::~NumericColumn()
dp::NumericColumn::~NumericColumn()
dp::WorksheetView::WorksheetView()
dp::WorksheetView::WorksheetView()
dp::WorksheetView::~WorksheetView()
dp::WorksheetView::~WorksheetView()
dp::WorksheetView::~WorksheetView()
dp::ColumnOrdering::ColumnOrdering()
dp::ColumnOrdering::ColumnOrdering()
dp::ColumnOrdering::~ColumnOrdering()
dp::ColumnOrdering::~ColumnOrdering()
dp::ColumnOrdering::~ColumnOrdering()
dp::ExcelXmlReader::mGetFormat(unsigned int, unsigned int, int&)
dp::ExcelXmlReader::GetAMPMMask[abi:cxx11]()
dp::ExcelXmlReader::GetTimeMask[abi:cxx11]()
dp::ExcelXmlReader::mInitialize()
dp::ExcelXmlReader::mSetFmtType(dp::xStyle&)
dp::ExcelXmlReader::beginWorksheet(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::ExcelXmlReader::readStringData(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&)
dp::ExcelXmlReader::setCurrentStyle(char const*)
dp::ExcelXmlReader::GetTimeSeparator[abi:cxx11]()
dp::ExcelXmlReader::IsStringAllBlank(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::ExcelXmlReader::mReadExcelStyles()
dp::ExcelXmlReader::mReadExcelWorkbook()
dp::ExcelXmlReader::mReadExcelWorksheet(std::vector<unsigned int, std::allocator<unsigned int> >&)
dp::ExcelXmlReader::IsDateTimeFormatType(dp::EXCEL_FORMAT_TYPE)
dp::ExcelXmlReader::mFormatExcelDateTime(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::ExcelXmlReader::removeEmptyWorksheets(std::vector<unsigned int, std::allocator<unsigned int> > const&)
dp::ExcelXmlReader::UpdateFormatsForLocale()
dp::ExcelXmlReader::mAddExternalDataRecord(dp::ExternalDataRecord&, bool)
dp::ExcelXmlReader::mReplaceDescWithFormat()
dp::ExcelXmlReader::mReadExcelWorksheetCell(unsigned int&, unsigned int, unsigned int)
dp::ExcelXmlReader::mReadExcelWorksheetData(unsigned int, unsigned int)
dp::ExcelXmlReader::createVextralNumericFormat(int)
dp::ExcelXmlReader::mSearchStyleIndexForFormat(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&, dp::xStyle*&, int&)
dp::ExcelXmlReader::mReadExcelWorksheetCellData(unsigned int, unsigned int)
dp::ExcelXmlReader::mReadExcelWorksheetDataHeader()
dp::ExcelXmlReader::GetLocaleDefaultDateTimeFormat(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&, unsigned int)
dp::ExcelXmlReader::masks()
dp::ExcelXmlReader::deliver(dp::ExternalDataRecord const&)
dp::ExcelXmlReader::isStyle(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::ExcelXmlReader::readRow(unsigned int, unsigned int)
dp::ExcelXmlReader::readData(bool)
dp::ExcelXmlReader::beginCell(unsigned int&, unsigned int&)
dp::ExcelXmlReader::ExcelXmlReader(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >, std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >, double, dp::IExcelDataProvider*, dp::IDateTimeVariableFormat*)
dp::ExcelXmlReader::ExcelXmlReader(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >, std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >, double, dp::IExcelDataProvider*, dp::IDateTimeVariableFormat*)
dp::ExcelXmlReader::~ExcelXmlReader()
dp::ExcelXmlReader::~ExcelXmlReader()
dp::ExcelXmlReader::~ExcelXmlReader()
dp::FormulaManager::FormulaManager()
dp::FormulaManager::FormulaManager()
dp::FormulaManager::~FormulaManager()
dp::FormulaManager::~FormulaManager()
dp::FormulaManager::~FormulaManager()
dp::GENERAL_FORMAT[abi:cxx11]
dp::PERCENT_SYMBOL[abi:cxx11]
dp::WorksheetCells::add(dp::ExternalDataRecord const&)
dp::WorksheetCells::clear()
dp::WorksheetCells::known(unsigned int)
dp::WorksheetCells::texts()
dp::WorksheetCells::WorksheetCells(dp::WorksheetCells&&)
dp::WorksheetCells::WorksheetCells(std::shared_ptr<dp::TextPool>)
dp::WorksheetCells::WorksheetCells(dp::WorksheetCells&&)
dp::WorksheetCells::WorksheetCells(std::shared_ptr<dp::TextPool>)
dp::WorksheetCells::~WorksheetCells()
dp::WorksheetCells::~WorksheetCells()
dp::WorksheetCells::operator=(dp::WorksheetCells&&)
dp::WorksheetCells::operator[](unsigned int)
dp::ExcelXLSXReader::readSheets()
dp::ExcelXLSXReader::mParseCharString(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&)
dp::ExcelXLSXReader::mReadExcelWorkbook()
dp::ExcelXLSXReader::mReadSharedStrings()
dp::ExcelXLSXReader::resolveNumberKinds()
dp::ExcelXLSXReader::mReadExcel2007Styles()
dp::ExcelXLSXReader::mReadExcel2007Worksheet(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::ExcelXLSXReader::mAddPredefined2007Styles()
dp::ExcelXLSXReader::mSearchWorkbookRelationships(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&, std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&)
dp::ExcelXLSXReader::readSheet(std::vector<unsigned int, std::allocator<unsigned int> >&)
dp::ExcelXLSXReader::ExcelXLSXReader(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&, bool, std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >, double, dp::IExcelDataProvider*, dp::IDateTimeVariableFormat*)
dp::ExcelXLSXReader::ExcelXLSXReader(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&, bool, std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >, double, dp::IExcelDataProvider*, dp::IDateTimeVariableFormat*)
dp::ExcelXLSXReader::~ExcelXLSXReader()
dp::ExcelXLSXReader::~ExcelXLSXReader()
dp::ExcelXLSXReader::~ExcelXLSXReader()
dp::ExpressionError::ExpressionError(dp::ExpressionError const&)
dp::ExpressionError::ExpressionError()
dp::ExpressionError::ExpressionError(dp::ExpressionError const&)
dp::ExpressionError::ExpressionError()
dp::ExpressionError::~ExpressionError()
dp::ExpressionError::~ExpressionError()
dp::ExpressionError::~ExpressionError()
dp::ExpressionError::operator=(dp::ExpressionError const&)
dp::FormulaModelNode::FormulaModelNode(dp::FormulaModelNode const&)
dp::FormulaModelNode::FormulaModelNode()
dp::FormulaModelNode::FormulaModelNode(dp::FormulaModelNode const&)
dp::FormulaModelNode::FormulaModelNode()
dp::FormulaModelNode::~FormulaModelNode()
dp::FormulaModelNode::~FormulaModelNode()
dp::FormulaModelNode::~FormulaModelNode()
dp::FormulaModelNode::operator=(dp::FormulaModelNode const&)
dp::GetShortDateMask[abi:cxx11]()
dp::xlsxDataProvider::GetWorksheets(char const*, std::vector<std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >, std::allocator<std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > > >&)
dp::xlsxDataProvider::removeUnpackedFile()
dp::xlsxDataProvider::OpenFile(char const*, dp::IDataProvider::FileAccess)
dp::xlsxDataProvider::CloseFile()
dp::xlsxDataProvider::unzipFile(char const*)
dp::xlsxDataProvider::xlsxDataProvider()
dp::xlsxDataProvider::xlsxDataProvider()
dp::xlsxDataProvider::~xlsxDataProvider()
dp::xlsxDataProvider::~xlsxDataProvider()
dp::xlsxDataProvider::~xlsxDataProvider()
dp::getRightSubString(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&, unsigned int)
dp::CleanWorksheetName(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&)
dp::ExternalDataRecord::initialize()
dp::ExternalDataRecord::ExternalDataRecord(dp::ExternalDataRecord const&)
dp::ExternalDataRecord::ExternalDataRecord(unsigned int, unsigned int, unsigned int, unsigned int)
dp::ExternalDataRecord::ExternalDataRecord(dp::ExternalDataRecord const&)
dp::ExternalDataRecord::ExternalDataRecord(unsigned int, unsigned int, unsigned int, unsigned int)
dp::ExternalDataRecord::~ExternalDataRecord()
dp::ExternalDataRecord::~ExternalDataRecord()
dp::ExternalDataRecord::operator=(dp::ExternalDataRecord const&)
dp::ReadOnlyCollection<int>::ReadOnlyCollection()
dp::ReadOnlyCollection<int>::ReadOnlyCollection()
dp::ReadOnlyCollection<int>::~ReadOnlyCollection()
dp::ReadOnlyCollection<int>::~ReadOnlyCollection()
dp::ReadOnlyCollection<int>::~ReadOnlyCollection()
dp::TextVariableFormat::TextVariableFormat()
dp::TextVariableFormat::TextVariableFormat()
dp::TextVariableFormat::~TextVariableFormat()
dp::TextVariableFormat::~TextVariableFormat()
dp::TextVariableFormat::~TextVariableFormat()
dp::parseDecimalFormat(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::FormulaVariableNode::FormulaVariableNode(dp::FormulaVariableNode const&)
dp::FormulaVariableNode::FormulaVariableNode()
dp::FormulaVariableNode::FormulaVariableNode(dp::FormulaVariableNode const&)
dp::FormulaVariableNode::FormulaVariableNode()
dp::FormulaVariableNode::~FormulaVariableNode()
dp::FormulaVariableNode::~FormulaVariableNode()
dp::FormulaVariableNode::~FormulaVariableNode()
dp::FormulaVariableNode::operator=(dp::FormulaVariableNode const&)
dp::parseCurrencyFormat(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::parseDateTimeFormat(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&, std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&, dp::EXCEL_FORMAT_TYPE&)
dp::SCIENTIFIC_LONG_FORM[abi:cxx11]
dp::parseScientficFormat(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::truncateToCharLength(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&, unsigned short)
dp::ExcelDataProviderBase::AddDDELink(dp::IDDELink*)
dp::ExcelDataProviderBase::RereadFile()
dp::ExcelDataProviderBase::_trueValue[abi:cxx11]
dp::ExcelDataProviderBase::AddAnalysis(dp::IAnalysis*)
dp::ExcelDataProviderBase::AddConstant(dp::ITextConstant*)
dp::ExcelDataProviderBase::AddConstant(dp::INumericConstant*)
dp::ExcelDataProviderBase::_falseValue[abi:cxx11]
dp::ExcelDataProviderBase::AddWorksheet(char const*)
dp::ExcelDataProviderBase::AddWorksheet(dp::IWorksheet*)
dp::ExcelDataProviderBase::GetDOEReader()
dp::ExcelDataProviderBase::SetPreviewing(bool)
dp::ExcelDataProviderBase::_inputDecimal
dp::ExcelDataProviderBase::_missingValue
dp::ExcelDataProviderBase::columnOptions(unsigned int, unsigned int)
dp::ExcelDataProviderBase::AddFormulaNode(dp::IFormulaNode*)
dp::ExcelDataProviderBase::AddMixturePlot(dp::IMixturePlot*)
dp::ExcelDataProviderBase::SetMissingText(char const*, char const*)
dp::ExcelDataProviderBase::SetUnitTesting(bool)
dp::ExcelDataProviderBase::_maxNumericInt
dp::ExcelDataProviderBase::_maxTextLength
dp::ExcelDataProviderBase::_outputDecimal
dp::ExcelDataProviderBase::AddCustomDesign(dp::ICustomDesign*)
dp::ExcelDataProviderBase::ClearWorksheets()
dp::ExcelDataProviderBase::GetInputDecimal()
dp::ExcelDataProviderBase::GetMissingValue()
dp::ExcelDataProviderBase::RemoveWorksheet(int)
dp::ExcelDataProviderBase::SetInputDecimal(char)
dp::ExcelDataProviderBase::SetMissingValue(double)
dp::ExcelDataProviderBase::SetNumericRange(double, double)
dp::ExcelDataProviderBase::AddFactorialPlot(dp::IFactorialPlot*)
dp::ExcelDataProviderBase::AddTaguchiDesign(dp::ITaguchiDesign*)
dp::ExcelDataProviderBase::GetOutputDecimal()
dp::ExcelDataProviderBase::SetOutputDecimal(char)
dp::ExcelDataProviderBase::SetTextDelimiter(char)
dp::ExcelDataProviderBase::_maxNumericValue
dp::ExcelDataProviderBase::_minNumericValue
dp::ExcelDataProviderBase::AddResponseModels(dp::IResponseModels*)
dp::ExcelDataProviderBase::GetVariableFinder()
dp::ExcelDataProviderBase::ResetInternalData()
dp::ExcelDataProviderBase::SetFieldDelimiter(char)
dp::ExcelDataProviderBase::SetMissingNumeric(double, double)
dp::ExcelDataProviderBase::SetTestNoTempFile(bool)
dp::ExcelDataProviderBase::SetWorksheetIndex(int)
dp::ExcelDataProviderBase::_missingValueText[abi:cxx11]
dp::ExcelDataProviderBase::AddTaguchiAnalysis(dp::ITaguchiAnalysis*)
dp::ExcelDataProviderBase::GetWorksheetFinder()
dp::ExcelDataProviderBase::GetBooleanTrueValue()
dp::ExcelDataProviderBase::SetBooleanTrueValue(char const*)
dp::ExcelDataProviderBase::SetDecimalSeparator(char)
dp::ExcelDataProviderBase::AddTaguchiPrediction(dp::ITaguchiPrediction*)
dp::ExcelDataProviderBase::GetBooleanFalseValue()
dp::ExcelDataProviderBase::GetMaximumTextLength()
dp::ExcelDataProviderBase::GetNumericMaximumInt()
dp::ExcelDataProviderBase::SetBooleanFalseValue(char const*)
dp::ExcelDataProviderBase::SetInferFormatPolicy(int)
dp::ExcelDataProviderBase::SetMaximumTextLength(int)
dp::ExcelDataProviderBase::SetReadOptionExclude(unsigned int, bool)
dp::ExcelDataProviderBase::AddExternalDataRecord(dp::ExternalDataRecord const&)
dp::ExcelDataProviderBase::_outputGroupingSymbol
dp::ExcelDataProviderBase::ClearReadColumnOptions()
dp::ExcelDataProviderBase::GetNumericMaximumValue()
dp::ExcelDataProviderBase::GetNumericMinimumValue()
dp::ExcelDataProviderBase::SetAlphaMissingNumeric(char const*, double)
dp::ExcelDataProviderBase::GetOutputGroupingSymbol()
dp::ExcelDataProviderBase::SetOutputGroupingSymbol(char)
dp::ExcelDataProviderBase::SetReadColumnOptionName(unsigned int, unsigned int, char const*)
dp::ExcelDataProviderBase::SetMaxVariableNameLength(unsigned int)
dp::ExcelDataProviderBase::SetReadOptionDataRowCount(unsigned int, unsigned int)
dp::ExcelDataProviderBase::RegisterSharedVariableBody(int, dp::IVariable*)
dp::ExcelDataProviderBase::SetReadColumnOptionExclude(unsigned int, unsigned int, bool)
dp::ExcelDataProviderBase::SetReadOptionFoldTextValues(bool)
dp::ExcelDataProviderBase::SetWriteOptionVariableNames(bool)
dp::ExcelDataProviderBase::AddVariabilityDataCollection(dp::IVariabilityDataCollection*)
dp::ExcelDataProviderBase::SetReadOptionCleanTextValues(bool)
dp::ExcelDataProviderBase::SetReadOptionIgnoreBlankRows(bool)
dp::ExcelDataProviderBase::SetReadColumnOptionColumnType(unsigned int, unsigned int, dp::IVariable::BasicDataType)
dp::ExcelDataProviderBase::SetReadOptionDataRowPositions(unsigned int, dp::EVariableNameRowSetting, unsigned int, unsigned int)
dp::ExcelDataProviderBase::AddMultipleResponseOptimization(dp::IMultipleResponseOptimization*)
dp::ExcelDataProviderBase::SetDateTimeVariableFormatHelper(dp::IDateTimeVariableFormat*)
dp::ExcelDataProviderBase::SetReadColumnOptionDestinationId(unsigned int, unsigned int, unsigned int)
dp::ExcelDataProviderBase::SetReadOptionCleanWorksheetNames(bool)
dp::ExcelDataProviderBase::AddMixtureResponseModelCollection(dp::IMixtureResponseModelCollection*)
dp::ExcelDataProviderBase::GetMissingValueTextRepresentation()
dp::ExcelDataProviderBase::SetMissingValueTextRepresentation(char const*)
dp::ExcelDataProviderBase::SetReadOptionConvertDateTimeToText(bool)
dp::ExcelDataProviderBase::SetReadOptionDefaultUseVariableNameRow(dp::EVariableNameRowSetting)
dp::ExcelDataProviderBase::SetReadOptionPadColumnsWithMissingValues(bool)
dp::ExcelDataProviderBase::AddRef()
dp::ExcelDataProviderBase::Release()
dp::ExcelDataProviderBase::AddModel(dp::IModel*)
dp::ExcelDataProviderBase::SetError(long)
dp::ExcelDataProviderBase::AddColumn(dp::ITextColumn*)
dp::ExcelDataProviderBase::AddColumn(dp::INumericColumn*)
dp::ExcelDataProviderBase::AddDesign(dp::IDesign*)
dp::ExcelDataProviderBase::AddMatrix(dp::IMatrix*)
dp::ExcelDataProviderBase::ExcelDataProviderBase()
dp::ExcelDataProviderBase::ExcelDataProviderBase()
dp::ExcelDataProviderBase::~ExcelDataProviderBase()
dp::ExcelDataProviderBase::~ExcelDataProviderBase()
dp::ExcelDataProviderBase::~ExcelDataProviderBase()
dp::NumericVariableFormat::NumericVariableFormat()
dp::NumericVariableFormat::NumericVariableFormat()
dp::NumericVariableFormat::~NumericVariableFormat()
dp::NumericVariableFormat::~NumericVariableFormat()
dp::NumericVariableFormat::~NumericVariableFormat()
dp::SCIENTIFIC_SHORT_FORM[abi:cxx11]
dp::parsePercentageFormat(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::DateTimeVariableFormat::SetDateTimeParameters(dp::IDateTimeVariableFormat const*)
dp::DateTimeVariableFormat::SetGlobalDateTimeFormat(dp::IString*)
dp::DateTimeVariableFormat::DateTimeVariableFormat(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::DateTimeVariableFormat::DateTimeVariableFormat()
dp::DateTimeVariableFormat::DateTimeVariableFormat(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::DateTimeVariableFormat::DateTimeVariableFormat()
dp::DateTimeVariableFormat::~DateTimeVariableFormat()
dp::DateTimeVariableFormat::~DateTimeVariableFormat()
dp::DateTimeVariableFormat::~DateTimeVariableFormat()
dp::ExternalDataRecordCell::initialize()
dp::ExternalDataRecordCell::ExternalDataRecordCell(dp::ExternalDataRecordCell const&)
dp::ExternalDataRecordCell::ExternalDataRecordCell()
dp::ExternalDataRecordCell::ExternalDataRecordCell(dp::ExternalDataRecordCell const&)
dp::ExternalDataRecordCell::ExternalDataRecordCell()
dp::ExternalDataRecordCell::~ExternalDataRecordCell()
dp::ExternalDataRecordCell::~ExternalDataRecordCell()
dp::ExternalDataRecordCell::operator=(dp::ExternalDataRecordCell const&)
dp::FORMAT_TOKEN_SEPARATOR[abi:cxx11]
dp::FractionVariableFormat::FractionVariableFormat()
dp::FractionVariableFormat::FractionVariableFormat()
dp::FractionVariableFormat::~FractionVariableFormat()
dp::FractionVariableFormat::~FractionVariableFormat()
dp::FractionVariableFormat::~FractionVariableFormat()
dp::DateTimeFormatEqualCode::DateTimeFormatEqualCode(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >)
dp::DateTimeFormatEqualCode::DateTimeFormatEqualCode(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >)
dp::SIGNIFICANT_DIGITS_MASK[abi:cxx11]
dp::FormulaModelVariableNode::FormulaModelVariableNode(dp::FormulaModelVariableNode const&)
dp::FormulaModelVariableNode::FormulaModelVariableNode()
dp::FormulaModelVariableNode::FormulaModelVariableNode(dp::FormulaModelVariableNode const&)
dp::FormulaModelVariableNode::FormulaModelVariableNode()
dp::FormulaModelVariableNode::~FormulaModelVariableNode()
dp::FormulaModelVariableNode::~FormulaModelVariableNode()
dp::FormulaModelVariableNode::~FormulaModelVariableNode()
dp::FormulaModelVariableNode::operator=(dp::FormulaModelVariableNode const&)
dp::PercentageVariableFormat::PercentageVariableFormat()
dp::PercentageVariableFormat::PercentageVariableFormat()
dp::PercentageVariableFormat::~PercentageVariableFormat()
dp::PercentageVariableFormat::~PercentageVariableFormat()
dp::PercentageVariableFormat::~PercentageVariableFormat()
dp::ReadOnlyStringCollection<dp::IString&>::ReadOnlyStringCollection()
dp::ReadOnlyStringCollection<dp::IString&>::ReadOnlyStringCollection()
dp::ReadOnlyStringCollection<dp::IString&>::~ReadOnlyStringCollection()
dp::ReadOnlyStringCollection<dp::IString&>::~ReadOnlyStringCollection()
dp::ReadOnlyStringCollection<dp::IString&>::~ReadOnlyStringCollection()
dp::createVextralDecimalFormat(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&)
dp::removeDirectoryAndContents(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::createVextralPercentageFormat(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&)
dp::createVextralScientificFormat(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&)
dp::SCIENTIFIC_SIGNIFICANT_DIGITS_MASK[abi:cxx11]
dp::xml::mReadForElements(XmlReader&, std::vector<std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >, std::allocator<std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > > > const&)
dp::trim(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&)
dp::CRows::CRows(dp::CRows const&)
dp::CRows::CRows()
dp::CRows::CRows(dp::CRows const&)
dp::CRows::CRows()
dp::CRows::~CRows()
dp::CRows::~CRows()
dp::CRows::~CRows()
dp::CRows::operator=(dp::CRows const&)
dp::ltrim(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&)
dp::String::String(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >)
dp::String::String(dp::String&&)
dp::String::String(dp::String const&)
dp::String::String()
dp::String::String(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >)
dp::String::String(dp::String&&)
dp::String::String(dp::String const&)
dp::String::String()
dp::String::~String()
dp::String::~String()
dp::String::~String()
dp::String::operator=(dp::String&&)
dp::String::operator=(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
dp::String::operator=(dp::String const&)
dp::IsNumber(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&, char, double*)
dp::CleanText(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >&)
dp::Worksheet::SetPrimeKey(int)
dp::Worksheet::GetFormulaManager()
dp::Worksheet::AddRef()
dp::Worksheet::GetView()
dp::Worksheet::Release()
dp::Worksheet::Worksheet()
dp::Worksheet::Worksheet()
dp::Worksheet::~Worksheet()
dp::Worksheet::~Worksheet()
dp::Worksheet::~Worksheet()
CmXmlCast::m_pInstance
CmXmlCast::instance()
XmlReader::mInitialize(std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&)
XmlReader::mGotoElement(char const*)
XmlReader::attributeText[abi:cxx11](char const*)
XmlReader::readToElement()
XmlReader::moveToAttribute(char const*)
XmlReader::mReadAttribute_NotSafe(int&, char const*)
XmlReader::readNode()
XmlReader::XmlReader()
XmlReader::XmlReader()
XmlReader::~XmlReader()
XmlReader::~XmlReader()
CmXmlException::code() const
dp::CellColumn::lower_bound(unsigned int) const
dp::CellColumn::upper_bound(unsigned int) const
dp::CellColumn::mergeLateCells() const
dp::CellColumn::find(unsigned int) const
dp::CellColumn::size() const
dp::CellColumn::count(unsigned int) const
dp::CellColumn::release(dp::PackedCell const&) const
dp::CellColumn::lateCells() const
dp::ColumnView::GetWidthSet() const
dp::ColumnView::GetAutoWiden() const
dp::ColumnView::GetWidth() const
dp::ColumnView::GetHidden() const
dp::TextColumn::GetDataType() const
dp::TextColumn::GetOrdering() const
dp::TextColumn::GetPosition() const
dp::TextColumn::GetPrimeKey() const
dp::TextColumn::GetRowCount() const
dp::TextColumn::GetTextValues() const
dp::TextColumn::IsFormatDirty() const
dp::TextColumn::GetDescription() const
dp::TextColumn::GetStorageType() const
dp::TextColumn::GetWorksheetId() const
dp::TextColumn::GetLastModified() const
dp::TextColumn::GetMissingCount() const
dp::TextColumn::UseDefaultVariableBody() const
dp::TextColumn::GetVariableBodyPrimeKey() const
dp::TextColumn::GetOriginalVariablePrimeKey() const
dp::TextColumn::IsCopy() const
dp::TextColumn::GetName() const
dp::TextColumn::GetType() const
dp::TextColumn::GetView() const
dp::TextColumn::Attached() const
dp::TextColumn::GetFormat() const
dp::FormulaNode::GetPrimeKey() const
dp::FormulaNode::GetChildNode(int) const
dp::FormulaNode::GetParentNode(int) const
dp::FormulaNode::GetChildNodeCount() const
dp::FormulaNode::GetParentNodeCount() const
dp::FormulaNode::GetDirty() const
dp::FormulaNode::GetState() const
dp::NumericColumn::GetDataType() const
dp::NumericColumn::GetPosition() const
dp::NumericColumn::GetPrimeKey() const
dp::NumericColumn::GetRowCount() const
dp::NumericColumn::IsFormatDirty() const
dp::NumericColumn::GetDescription() const
dp::NumericColumn::GetStorageType() const
dp::NumericColumn::GetWorksheetId() const
dp::NumericColumn::GetLastModified() const
dp::NumericColumn::GetMissingCount() const
dp::NumericColumn::GetFormattedValue(double, char) const
dp::NumericColumn::UseDefaultVariableBody() const
dp::NumericColumn::GetVariableBodyPrimeKey() const
dp::NumericColumn::GetConvertedMissingCount() const
dp::NumericColumn::GetOriginalVariablePrimeKey() const
dp::NumericColumn::IsCopy() const
dp::NumericColumn::GetName() const
dp::NumericColumn::GetType() const
dp::NumericColumn::GetView() const
dp::NumericColumn::Attached() const
dp::NumericColumn::GetFormat() const
dp::NumericColumn::GetValues() const
dp::WorksheetView::GetActiveRow() const
dp::WorksheetView::GetPrintGrid() const
dp::WorksheetView::GetAllColumns() const
dp::WorksheetView::GetActiveColumn() const
dp::WorksheetView::GetMissingValue() const
dp::WorksheetView::GetDataFontStyle() const
dp::WorksheetView::GetTopVisibleRow() const
dp::WorksheetView::GetLabelFontStyle() const
dp::WorksheetView::GetPrintRowLabels() const
dp::WorksheetView::GetHorizontalEntry() const
dp::WorksheetView::GetDataFontFaceName() const
dp::WorksheetView::GetPrintColumnNames() const
dp::WorksheetView::GetDataFontPointSize() const
dp::WorksheetView::GetLabelFontFaceName() const
dp::WorksheetView::GetPrintColumnLabels() const
dp::WorksheetView::GetLabelFontPointSize() const
dp::WorksheetView::GetPrintJustification() const
dp::WorksheetView::GetStandardColumnWidth() const
dp::WorksheetView::GetLeftmostVisibleColumn() const
dp::ColumnOrdering::GetValueOrder() const
dp::ColumnOrdering::GetOrderedTextValues() const
dp::ExcelXmlReader::isOnElement(char const*) const
dp::ExcelXmlReader::GetExcelFormatType(int) const
dp::ExcelXmlReader::typeAt(int) const
dp::ExcelXmlReader::isInTable(int) const
dp::FormulaManager::GetFormulaNode(int) const
dp::FormulaManager::GetRecalculate() const
dp::FormulaManager::GetDecimalSymbol() const
dp::FormulaManager::GetListSeparator() const
dp::FormulaManager::GetFormulaNodeCount() const
dp::FormulaManager::GetUpdateAutomatically() const
dp::FormulaManager::GetStatusUpdateRequired() const
dp::WorksheetCells::nth(unsigned long) const
dp::WorksheetCells::settle() const
dp::WorksheetCells::inOrder() const
dp::WorksheetCells::rowCount() const
dp::ExpressionError::GetPosition() const
dp::ExpressionError::GetRepeatCount() const
dp::ExpressionError::GetArgumentCount() const
dp::ExpressionError::GetCode() const
dp::ExpressionError::GetLine() const
dp::ExpressionError::GetLetter() const
dp::FormulaModelNode::GetModelType() const
dp::FormulaModelNode::GetModelPrimeKey() const
dp::FormulaModelNode::GetVariablePrimeKey() const
dp::FormulaModelNode::GetTerms() const
dp::xlsxDataProvider::GetTempDirectoryPath[abi:cxx11]() const
dp::xlsxDataProvider::IsDateTimeFormatType(dp::ExternalDataRecordCell const&) const
dp::xlsxDataProvider::CreateVextralNumericFormat(dp::ExternalDataRecordCell const&) const
dp::ReadOnlyCollection<int>::Item(unsigned long) const
dp::ReadOnlyCollection<int>::Count() const
dp::TextVariableFormat::FormatValue(double, bool) const
dp::TextVariableFormat::GetCharacterCount() const
dp::TextVariableFormat::GetAuto() const
dp::TextVariableFormat::GetType() const
dp::FormulaVariableNode::GetFormula() const
dp::FormulaVariableNode::GetExpressionError(int) const
dp::FormulaVariableNode::GetVariablePosition(int, int*, int*) const
dp::FormulaVariableNode::GetVariablePrimeKey() const
dp::FormulaVariableNode::GetExpressionErrorCount() const
dp::FormulaVariableNode::GetVariablePositionCount() const
dp::ExcelDataProviderBase::FindColumn(int, dp::IColumn**, dp::ColumnType, dp::IVariableFormat::FormatType*, bool) const
dp::ExcelDataProviderBase::FindColumn(int, dp::IColumn**, dp::IVariable::StorageType, dp::IVariableFormat::FormatType*, bool) const
dp::ExcelDataProviderBase::FindColumn(int, dp::IColumn**, bool) const
dp::ExcelDataProviderBase::FindMatrix(int, dp::IMatrix**) const
dp::ExcelDataProviderBase::isExcluded(unsigned int) const
dp::ExcelDataProviderBase::FindLastRow(unsigned int) const
dp::ExcelDataProviderBase::GetFileName[abi:cxx11]() const
dp::ExcelDataProviderBase::FindConstant(int, dp::IConstant**) const
dp::ExcelDataProviderBase::IsPreviewing() const
dp::ExcelDataProviderBase::loadSettings(unsigned int, dp::CellColumn const&, dp::CellFormats const&) const
dp::ExcelDataProviderBase::plainOptions(unsigned int) const
dp::ExcelDataProviderBase::FindBlankRows(unsigned int) const
dp::ExcelDataProviderBase::FindWorksheet(int, dp::IWorksheet**) const
dp::ExcelDataProviderBase::firstDataType(unsigned int, dp::CellColumn const&, dp::ColumnType) const
dp::ExcelDataProviderBase::GetColumnCount(int) const
dp::ExcelDataProviderBase::LoadTextColumn(unsigned int, dp::CellColumn const&, unsigned int, unsigned int, std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&, int) const
dp::ExcelDataProviderBase::HandleBlankRows(dp::INumericColumn*, unsigned int, unsigned int, unsigned int, dp::CellColumn::const_iterator) const
dp::ExcelDataProviderBase::columnOptionsOf(unsigned int) const
dp::ExcelDataProviderBase::worksheetExists(unsigned int) const
dp::ExcelDataProviderBase::GetMissingTextTo() const
dp::ExcelDataProviderBase::GetWorksheetName[abi:cxx11](int) const
dp::ExcelDataProviderBase::ConvertCellToReal(dp::ExternalDataRecordCell const&, bool, dp::IString const*, bool&) const
dp::ExcelDataProviderBase::GetModelPrimeKeys(dp::IModel::ModelSubtype, int) const
dp::ExcelDataProviderBase::GetWorksheetCount() const
dp::ExcelDataProviderBase::LoadNumericColumn(unsigned int, dp::CellColumn const&, unsigned int, unsigned int, std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> > const&, int, dp::IVariableFormat::FormatType*) const
dp::ExcelDataProviderBase::GetColumnPrimeKeys(int) const
dp::ExcelDataProviderBase::GetMatrixPrimeKeys(int) const
dp::ExcelDataProviderBase::GetMissingTextFrom() const
dp::ExcelDataProviderBase::GetMissingVxlValue() const
dp::ExcelDataProviderBase::conversionSettings() const
dp::ExcelDataProviderBase::CalculateRowOffsets(unsigned int) const
dp::ExcelDataProviderBase::ConvertCellToString[abi:cxx11](dp::ExternalDataRecordCell const&, bool) const
dp::ExcelDataProviderBase::GetMissingNumericTo() const
dp::ExcelDataProviderBase::variableNameInSheet[abi:cxx11](unsigned int, dp::CellColumn const&) const
dp::ExcelDataProviderBase::GetConstantPrimeKeys(int) const
dp::ExcelDataProviderBase::GetTempDirectoryPath[abi:cxx11]() const
dp::ExcelDataProviderBase::GetWorksheetPosition(unsigned int) const
dp::ExcelDataProviderBase::GetWorksheetPrimeKey(unsigned int) const
dp::ExcelDataProviderBase::GetWorksheetRowCount(unsigned int) const
dp::ExcelDataProviderBase::InferVariableNameRow(unsigned int) const
dp::ExcelDataProviderBase::GetLoadColumnRowCount(unsigned int, dp::CellColumn const&) const
dp::ExcelDataProviderBase::GetMissingNumericFrom() const
dp::ExcelDataProviderBase::GetWorksheetPrimeKeys() const
dp::ExcelDataProviderBase::GetPreviewNumberOfRows() const
dp::ExcelDataProviderBase::GetPreviewNumberOfColumns() const
dp::ExcelDataProviderBase::optionsWithDefaultSetting(unsigned int) const
dp::ExcelDataProviderBase::ConvertNumericCellToString[abi:cxx11](dp::ExternalDataRecordCell const&) const
dp::ExcelDataProviderBase::GetAlphaMissingNumericFrom() const
dp::ExcelDataProviderBase::GetWriteOptionVariableNames() const
dp::ExcelDataProviderBase::GetDateTimeVariableFormatHelper() const
dp::ExcelDataProviderBase::FindRegisteredSharedVariableBody(int, dp::IVariable**) const
dp::ExcelDataProviderBase::noKeys() const
dp::ExcelDataProviderBase::cellsOf(unsigned int) const
dp::ExcelDataProviderBase::GetError() const
dp::ExcelDataProviderBase::FindModel(int, dp::IModel**) const
dp::ExcelDataProviderBase::GetColumn(int, int) const
dp::ExcelDataProviderBase::rowLayout(unsigned int) const
dp::NumericVariableFormat::FormatValue(double, bool) const
dp::NumericVariableFormat::GetValueRange(double*, double*) const
dp::NumericVariableFormat::GetDecimalPlaces(int*, int*) const
dp::NumericVariableFormat::GetNumericSubtype() const
dp::NumericVariableFormat::ShowFullPrecision() const
dp::NumericVariableFormat::GetAuto() const
dp::NumericVariableFormat::GetType() const
dp::DateTimeVariableFormat::FormatValue(double, bool) const
dp::DateTimeVariableFormat::GenerateTime(int, int, int, int, int, int, int) const
dp::DateTimeVariableFormat::GetFormatString() const
dp::DateTimeVariableFormat::ValidVextralTime(double) const
dp::DateTimeVariableFormat::ConvertToDatetime(dp::IString const*, dp::IString*, double&) const
dp::DateTimeVariableFormat::GetCurrentVextralTime() const
dp::DateTimeVariableFormat::GetDateTimeParameters(unsigned int*, unsigned int*, unsigned int*, unsigned int*) const
dp::DateTimeVariableFormat::CovertVextralDateTimeToString(double) const
dp::DateTimeVariableFormat::GetAuto() const
dp::DateTimeVariableFormat::GetType() const
dp::FractionVariableFormat::FormatValue(double, bool) const
dp::FractionVariableFormat::GetValueRange(double*, double*) const
dp::FractionVariableFormat::GetDenominator() const
dp::FractionVariableFormat::GetDecimalPlaces(int*, int*) const
dp::FractionVariableFormat::GetMaximumDigits() const
dp::FractionVariableFormat::GetMixedFraction() const
dp::FractionVariableFormat::GetNumericSubtype() const
dp::FractionVariableFormat::ShowFullPrecision() const
dp::FractionVariableFormat::GetFixedDenominator() const
dp::FractionVariableFormat::GetAuto() const
dp::FractionVariableFormat::GetType() const
dp::DateTimeFormatEqualCode::operator()(dp::xStyle const&) const
dp::FormulaModelVariableNode::GetVariablePrimeKey() const
dp::PercentageVariableFormat::FormatValue(double, bool) const
dp::PercentageVariableFormat::GetValueRange(double*, double*) const
dp::PercentageVariableFormat::GetDecimalPlaces(int*, int*) const
dp::PercentageVariableFormat::GetDecimalPlaces() const
dp::PercentageVariableFormat::GetNumericSubtype() const
dp::PercentageVariableFormat::ShowFullPrecision() const
dp::PercentageVariableFormat::GetAuto() const
dp::PercentageVariableFormat::GetType() const
dp::ReadOnlyStringCollection<dp::IString&>::Item(unsigned long) const
dp::ReadOnlyStringCollection<dp::IString&>::Count() const
dp::CRows::UseAllRows() const
dp::CRows::GetRowCount() const
dp::CRows::GetRows(int*, int const**) const
dp::String::database_str() const
dp::String::application_str() const
dp::CellView::operator dp::ExternalDataRecordCell() const
dp::Worksheet::GetCreator[abi:cxx11]() const
dp::Worksheet::GetVersion() const
dp::Worksheet::GetAnalysis() const
dp::Worksheet::GetComments[abi:cxx11]() const
dp::Worksheet::GetPrimeKey() const
dp::Worksheet::GetOSVersion() const
dp::Worksheet::GetDDELinkCount() const
dp::Worksheet::GetCreationDates[abi:cxx11]() const
dp::Worksheet::GetFormulaManager() const
dp::Worksheet::GetResponseModels() const
dp::Worksheet::GetHiddenColumnsUsed() const
dp::Worksheet::GetView() const
dp::Worksheet::GetTitle[abi:cxx11]() const
dp::Worksheet::GetDesign() const
CmXmlCast::mCast(double&, char const*) const
CmXmlCast::mCast(int&, char const*) const
CmXmlCast::mCast(unsigned int&, char const*) const
XmlReader::nodeName() const
XmlReader::nodeType() const
XmlReader::nodeValue() const
non-virtual thunk to dp::xlsxDataProvider::~xlsxDataProvider()
non-virtual thunk to dp::xlsxDataProvider::~xlsxDataProvider()
non-virtual thunk to dp::ExcelDataProviderBase::RegisterSharedVariableBody(int, dp::IVariable*)
non-virtual thunk to dp::ExcelDataProviderBase::~ExcelDataProviderBase()
non-virtual thunk to dp::ExcelDataProviderBase::~ExcelDataProviderBase()
non-virtual thunk to dp::ExcelDataProviderBase::FindColumn(int, dp::IColumn**, dp::IVariable::StorageType, dp::IVariableFormat::FormatType*, bool) const
non-virtual thunk to dp::ExcelDataProviderBase::FindColumn(int, dp::IColumn**, bool) const
non-virtual thunk to dp::ExcelDataProviderBase::FindMatrix(int, dp::IMatrix**) const
non-virtual thunk to dp::ExcelDataProviderBase::FindConstant(int, dp::IConstant**) const
non-virtual thunk to dp::ExcelDataProviderBase::GetModelPrimeKeys(dp::IModel::ModelSubtype, int) const
non-virtual thunk to dp::ExcelDataProviderBase::GetColumnPrimeKeys(int) const
non-virtual thunk to dp::ExcelDataProviderBase::GetMatrixPrimeKeys(int) const
non-virtual thunk to dp::ExcelDataProviderBase::GetConstantPrimeKeys(int) const
non-virtual thunk to dp::ExcelDataProviderBase::FindRegisteredSharedVariableBody(int, dp::IVariable**) const
non-virtual thunk to dp::ExcelDataProviderBase::FindModel(int, dp::IModel**) const
non-virtual thunk to dp::FormulaModelNode::~FormulaModelNode()
non-virtual thunk to dp::FormulaModelNode::~FormulaModelNode()
non-virtual thunk to dp::FormulaVariableNode::~FormulaVariableNode()
non-virtual thunk to dp::FormulaVariableNode::~FormulaVariableNode()
non-virtual thunk to dp::FormulaModelVariableNode::~FormulaModelVariableNode()
non-virtual thunk to dp::FormulaModelVariableNode::~FormulaModelVariableNode()
non-virtual thunk to dp::FormulaModelNode::GetModelType() const
non-virtual thunk to dp::FormulaModelNode::GetModelPrimeKey() const
non-virtual thunk to dp::FormulaModelNode::GetVariablePrimeKey() const
non-virtual thunk to dp::FormulaModelNode::GetTerms() const
non-virtual thunk to dp::FormulaVariableNode::GetFormula() const
non-virtual thunk to dp::FormulaVariableNode::GetExpressionError(int) const
non-virtual thunk to dp::FormulaVariableNode::GetVariablePosition(int, int*, int*) const
non-virtual thunk to dp::FormulaVariableNode::GetVariablePrimeKey() const
non-virtual thunk to dp::FormulaVariableNode::GetExpressionErrorCount() const
non-virtual thunk to dp::FormulaVariableNode::GetVariablePositionCount() const
non-virtual thunk to dp::FormulaModelVariableNode::GetVariablePrimeKey() const
non-virtual thunk to dp::TextColumn::SetPrimeKey(int)
non-virtual thunk to dp::TextColumn::SetVariableBodyPrimeKey(int)
non-virtual thunk to dp::TextColumn::SetOriginalVariablePrimeKey(int)
non-virtual thunk to dp::TextColumn::~TextColumn()
non-virtual thunk to dp::TextColumn::~TextColumn()
non-virtual thunk to dp::NumericColumn::SetPrimeKey(int)
non-virtual thunk to dp::NumericColumn::SetVariableBodyPrimeKey(int)
non-virtual thunk to dp::NumericColumn::SetOriginalVariablePrimeKey(int)
non-virtual thunk to dp::NumericColumn::~NumericColumn()
non-virtual thunk to dp::NumericColumn::~NumericColumn()
non-virtual thunk to dp::xlsxDataProvider::~xlsxDataProvider()
non-virtual thunk to dp::xlsxDataProvider::~xlsxDataProvider()
non-virtual thunk to dp::ExcelDataProviderBase::~ExcelDataProviderBase()
non-virtual thunk to dp::ExcelDataProviderBase::~ExcelDataProviderBase()
non-virtual thunk to dp::TextColumn::GetPosition() const
non-virtual thunk to dp::TextColumn::GetPrimeKey() const
non-virtual thunk to dp::TextColumn::GetWorksheetId() const
non-virtual thunk to dp::TextColumn::UseDefaultVariableBody() const
non-virtual thunk to dp::TextColumn::GetVariableBodyPrimeKey() const
non-virtual thunk to dp::TextColumn::GetOriginalVariablePrimeKey() const
non-virtual thunk to dp::TextColumn::IsCopy() const
non-virtual thunk to dp::TextColumn::GetType() const
non-virtual thunk to dp::TextColumn::Attached() const
non-virtual thunk to dp::NumericColumn::GetPosition() const
non-virtual thunk to dp::NumericColumn::GetPrimeKey() const
non-virtual thunk to dp::NumericColumn::GetWorksheetId() const
non-virtual thunk to dp::NumericColumn::UseDefaultVariableBody() const
non-virtual thunk to dp::NumericColumn::GetVariableBodyPrimeKey() const
non-virtual thunk to dp::NumericColumn::GetOriginalVariablePrimeKey() const
non-virtual thunk to dp::NumericColumn::IsCopy() const
non-virtual thunk to dp::NumericColumn::GetType() const
non-virtual thunk to dp::NumericColumn::Attached() const
non-virtual thunk to dp::ExcelDataProviderBase::FindWorksheet(int, dp::IWorksheet**) const
non-virtual thunk to dp::ExcelDataProviderBase::GetWorksheetPrimeKeys() const
