// Opens a window with a plain list of Qt's, and prints the seconds until it is shown. A first, empty one is
// not measured: what a toolkit does once in a process is not what a list costs.
#include <QApplication>
#include <QListView>
#include <QStringList>
#include <QStringListModel>
#include <QTest>

#include <cstdio>
#include <string>
#include <vector>

#include "bench/PeerWindow.h"

namespace
{
class List : public QListView
{
public:
    bool painted = false;

protected:
    void paintEvent(QPaintEvent* event) override
    {
        QListView::paintEvent(event);
        painted = true;
    }
};

bool show(const std::vector<std::string>& lines)
{
    QStringList rows;
    for (const std::string& line : lines)
        rows.append(QString::fromStdString(line));
    QStringListModel model(rows);
    List list;
    list.setUniformItemSizes(true); // or every row is measured before the first is drawn
    list.setModel(&model);
    list.resize(bench::kPeerWidth, bench::kPeerHeight);
    list.show();
    const bool isShown = QTest::qWaitForWindowExposed(&list) && QTest::qWaitFor([&] { return list.painted; });
    QGuiApplication::sync();
    return isShown && model.rowCount() == static_cast<int>(lines.size());
}
} // namespace

int main(int argc, char** argv)
{
    QApplication application(argc, argv);
    return bench::runPeer(argc, argv, show);
}
