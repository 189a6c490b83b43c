#include "support/testfiles.h"

#include <QDir>
#include <QFile>

namespace qmtest {

std::string readfile(const QString& path)
{
    QFile f(path);
    if (!f.open(QIODevice::ReadOnly))
        return {};
    const QByteArray b = f.readAll();
    return std::string(b.constData(), static_cast<size_t>(b.size()));
}

void writefile(const QString& path, const std::string& bytes)
{
    QFile f(path);
    if (f.open(QIODevice::WriteOnly | QIODevice::Truncate))
        f.write(bytes.data(), static_cast<qint64>(bytes.size()));
}

QString samplefile()
{
    return QStringLiteral(QM_EXAMPLES_DIR "/sample.ged");
}

QString corpusdir()
{
    const QString dir = QStringLiteral(QM_CORPUS_DIR);
    return QDir(dir).exists() ? QDir(dir).canonicalPath() : QString();
}

} // namespace qmtest
