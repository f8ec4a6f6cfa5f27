#include "dpxlsx/model/rows.h"

namespace dp {

CRows::CRows() = default;
CRows::CRows(const CRows&) = default;
CRows& CRows::operator=(const CRows&) = default;
CRows::~CRows() = default;

bool CRows::UseAllRows() const { return useAllRows; }
int CRows::GetRowCount() const { return rowCount; }

void CRows::GetRows(int* count, const int** listed) const {
    if (count) *count = static_cast<int>(rows.size());
    if (listed) *listed = rows.data();
}

}  // namespace dp
