// Out of line, so that the class has one identity across libraries.

#include "hqf/zip/CZipException.h"

CZipException::CZipException(int cause, const std::wstring& fileName)
    : file_name_(fileName)
    , cause_(cause) {}

CZipException::~CZipException() = default;
