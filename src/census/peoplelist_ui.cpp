#include "census/peoplelist_ui.h"

#include "model/loadgedcom.h"

namespace qm {

void peoplelistmodel::setpeople(const gedcomindex* index, std::vector<int32_t> positions, bool idonly)
{
    beginResetModel();
    index_ = index;
    idonly_ = idonly;
    positions_ = std::move(positions);
    entries_.clear();
    endResetModel();
}

void peoplelistmodel::setentries(std::vector<listentry> entries)
{
    beginResetModel();
    positions_.clear();
    entries_ = std::move(entries);
    endResetModel();
}

void peoplelistmodel::clear()
{
    beginResetModel();
    positions_.clear();
    entries_.clear();
    endResetModel();
}

int32_t peoplelistmodel::personat(int row) const
{
    if (row < 0)
        return -1;
    const auto r = static_cast<size_t>(row);
    if (!entries_.empty())
        return r < entries_.size() ? entries_[r].person : -1;
    return r < positions_.size() ? positions_[r] : -1;
}

QString peoplelistmodel::textat(int row) const
{
    if (row < 0)
        return {};
    const auto r = static_cast<size_t>(row);
    if (!entries_.empty())
        return r < entries_.size() ? entries_[r].text : QString();
    if (r >= positions_.size() || !index_)
        return {};
    return personlabel(index_->people[static_cast<size_t>(positions_[r])], idonly_);
}

int peoplelistmodel::rowCount(const QModelIndex& parent) const
{
    if (parent.isValid())
        return 0;
    return static_cast<int>(entries_.empty() ? positions_.size() : entries_.size());
}

QVariant peoplelistmodel::data(const QModelIndex& index, int role) const
{
    if (!index.isValid())
        return {};
    if (role == Qt::DisplayRole || role == Qt::AccessibleTextRole)
        return textat(index.row());
    if (role == Qt::UserRole)
        return personat(index.row());
    return {};
}

} // namespace qm
