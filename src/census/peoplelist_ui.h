#pragma once
// The lists of individuals of the main window (all individuals, those who
// could be alive at the census, the immediate family): a list model over
// positions in the index, so that tens of thousands of entries appear at once
// and a label is made only when its row is drawn.

#include "census/selection.h"
#include "model/gedcomindex.h"

#include <QAbstractListModel>

#include <vector>

namespace qm {

class peoplelistmodel : public QAbstractListModel {
    Q_OBJECT
public:
    using QAbstractListModel::QAbstractListModel;

    // Individuals at these positions of index.people, in this order; labels
    // are made from the index when shown.
    void setpeople(const gedcomindex* index, std::vector<int32_t> positions, bool idonly);
    // Entries with ready-made texts (the immediate family).
    void setentries(std::vector<listentry> entries);
    void clear();

    // Position in people of the individual at row, or -1.
    int32_t personat(int row) const;
    QString textat(int row) const;

    int rowCount(const QModelIndex& parent = QModelIndex()) const override;
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;

private:
    const gedcomindex* index_ = nullptr;
    bool idonly_ = false;
    std::vector<int32_t> positions_;
    std::vector<listentry> entries_;
};

} // namespace qm
