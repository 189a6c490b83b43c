#pragma once
// Census Coverage: a grid of the family file's individuals by the censuses of
// one country, each cell saying whether the file records the individual in
// that census (tools/coverage.h). Filters (gaps only, relatives of one
// individual, a name), the order (name or birth year), totals per census in
// the column headings, export to CSV, and "Transcribe" on a missing cell,
// which hands the individual and the census year to whoever opened the
// window. The window is not modal: it stays open while households are entered
// and is given the index again whenever the family file has been read again.
//
// A table model and a view: only the rows on screen are drawn, so a file of a
// hundred thousand individuals opens at once.

#include "settings/settings.h"
#include "tools/coverage.h"

#include <QAbstractTableModel>
#include <QDialog>

#include <array>
#include <functional>
#include <vector>

class QCheckBox;
class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QTableView;
class QTimer;

namespace qm {

class prompts;

// The grid's rows (individuals), its columns (name, record number, birth
// year, the censuses) and the totals of the rows shown in the census headings.
class coveragemodel : public QAbstractTableModel {
    Q_OBJECT
public:
    static constexpr int namecolumn = 0, idcolumn = 1, borncolumn = 2, firstcensuscolumn = 3;

    using QAbstractTableModel::QAbstractTableModel;

    // The coverage shown and the individuals of its rows, in order.
    void setrows(const gedcomindex* index, const censuscoverage* c, std::vector<int32_t> rows);

    // Position in people of the individual of a row, -1 when none.
    int32_t personat(int row) const;
    // The row of an individual (position in people), -1 when not shown.
    int rowof(int32_t person) const;
    // The census column of a grid column, -1 for the name and birth year.
    int censusat(int column) const { return column >= firstcensuscolumn ? column - firstcensuscolumn : -1; }
    const std::vector<int32_t>& rows() const { return rows_; }

    int rowCount(const QModelIndex& parent = QModelIndex()) const override;
    int columnCount(const QModelIndex& parent = QModelIndex()) const override;
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

private:
    const gedcomindex* index_ = nullptr;
    const censuscoverage* coverage_ = nullptr;
    std::vector<int32_t> rows_;
    std::vector<std::array<int32_t, coveragecellkinds>> totals_; // of the rows shown, per census
};

// The symbol and word a cell shows: "✘ missing".
QString coveragecelltext(coveragecell c);

class coveragefrm : public QDialog {
    Q_OBJECT
public:
    // Called with the individual (position in people) and the census year (as
    // the census table shows it) of a missing cell the user chose to transcribe.
    using transcribefn = std::function<void(int32_t person, int year)>;

    // The index must stay alive until setindex() gives another or the window
    // is gone; the settings until the window is gone (they are read as they
    // are when needed). Their country is the one the grid opens on and the
    // only one whose censuses can be transcribed; their "Residence" decides
    // whether residence facts are census entries (a change is seen when the
    // window is next activated).
    coveragefrm(const gedcomindex& index, const settings& s, prompts& p, transcribefn transcribe,
                QWidget* parent = nullptr);

    // The family file was read again (or the settings changed): the grid is
    // worked out again, keeping its filters, order and the cell chosen.
    void setindex(const gedcomindex& index, const settings& s);

    const censuscoverage& coverage() const { return coverage_; }
    const coveragemodel& model() const { return *model_; }

protected:
    void changeEvent(QEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void build();
    void compute();       // the coverage of the country chosen, then order()
    void order();         // every individual in the order chosen, then refilter()
    void refilter();      // the rows the filters let through
    void relativeschosen(int item);
    void currentchanged();
    void transcribecurrent();
    void exportcsv();

    const gedcomindex* index_;
    const settings* settings_;
    bool residence_ = false; // the "Residence" the coverage was worked out with
    prompts& prompts_;
    transcribefn transcribe_;
    censuscoverage coverage_;
    std::vector<int32_t> ordered_;
    int32_t relativeof_ = -1; // the individual whose relatives are shown (position in people)
    // Record numbers of the individual chosen in the grid and of relativeof_,
    // to find them again in the next index.
    int32_t currentid_ = -1, relativeid_ = -1;

    QComboBox* countrycom_ = nullptr;
    QCheckBox* gapschk_ = nullptr;
    QComboBox* relativescom_ = nullptr;
    QLabel* relativelab_ = nullptr;
    QLineEdit* nametxt_ = nullptr;
    QComboBox* sortcom_ = nullptr;
    QTableView* grid_ = nullptr;
    coveragemodel* model_ = nullptr;
    QLabel* celllab_ = nullptr;
    QLabel* countlab_ = nullptr;
    QPushButton* transcribebut_ = nullptr;
    QPushButton* exportbut_ = nullptr;
    QPushButton* helpbut_ = nullptr;
    QPushButton* closebut_ = nullptr;
    QTimer* searchtimer_ = nullptr;
};

} // namespace qm
