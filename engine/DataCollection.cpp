#include "DataCollection.h"

#include <algorithm>

cDataCollection::cDataCollection(int32_t rows, int32_t columns) {
    Resize(rows, columns);
}

cDataCollection::cDataCollection(const cDataCollection& other)
    : rows_(other.rows_),
      columns_(other.columns_),
      capacity_(other.rows_),
      values_(other.values_.begin(),
              other.values_.begin() + static_cast<size_t>(other.rows_) * other.columns_),
      description_(other.description_ ? other.description_->Clone() : nullptr) {}

cDataCollection& cDataCollection::operator=(const cDataCollection& other) {
    if (this != &other) {
        cDataCollection copy(other);
        rows_ = copy.rows_;
        columns_ = copy.columns_;
        capacity_ = copy.capacity_;
        values_ = std::move(copy.values_);
        description_ = std::move(copy.description_);
    }
    return *this;
}

cDataCollection::~cDataCollection() = default;

int32_t cDataCollection::Resize(int32_t rows, int32_t columns) {
    rows = std::max(rows, 0);
    columns = std::max(columns, 0);
    if (rows == rows_ && columns == columns_) return 0;
    const size_t count = static_cast<size_t>(rows) * columns;
    if (count > static_cast<size_t>(rows_) * columns_) {
        values_.assign(count, 0.0);
        capacity_ = rows;
    } else {
        // The buffer stays; its capacity is counted in rows of the new width.
        capacity_ =
            columns == 0 ? 0 : static_cast<int32_t>(static_cast<int64_t>(capacity_) * columns_ / columns);
    }
    rows_ = rows;
    columns_ = columns;
    return 0;
}

void cDataCollection::SetDescription(const ColorSpaceStruct* description) {
    description_ = description ? description->Clone() : nullptr;
}
