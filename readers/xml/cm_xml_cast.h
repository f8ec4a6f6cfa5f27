#pragma once

#include "dpxlsx/model/host/export.h"

// Converts the numbers of XML documents, whose decimal separator is a point in every locale.
class DPXLSX_API CmXmlCast {
  public:
    // The one instance of the process, made when first needed and never destroyed.
    static CmXmlCast& instance();

    // Sets `value` to the number that `text` begins with, 0 when there is none.
    void mCast(double& value, const char* text) const;
    // Sets `value` to the integer that `text` begins with, white space and a sign before it
    // allowed. False, and `value` as it was, when there is none. A number out of range becomes the
    // nearest one in range; an unsigned number with a minus wraps around while its digits are in
    // range, and is the largest one beyond.
    bool mCast(int& value, const char* text) const;
    bool mCast(unsigned& value, const char* text) const;

    static CmXmlCast* m_pInstance;
};
