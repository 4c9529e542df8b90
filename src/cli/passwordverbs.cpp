// Veltrix — KPI dashboard for small businesses.
#include "passwordverbs.h"

#include "cipher/passwordcipher.h"
#include "common/settings.h"

#include <QTextStream>

using namespace Qt::StringLiterals;

namespace PasswordVerbs {

int encryptPassword(const QStringList &arguments)
{
    if (arguments.size() != 1) {
        QTextStream(stderr) << "usage: veltrix-cli encrypt-password TEXT" << Qt::endl;
        return 2;
    }
    PasswordCipher cipher;
    QTextStream(stdout) << cipher.encryptText(arguments.first(), Settings::PasswordKey) << Qt::endl;
    return 0;
}

int decryptPassword(const QStringList &arguments)
{
    if (arguments.size() != 1) {
        QTextStream(stderr) << "usage: veltrix-cli decrypt-password STORED" << Qt::endl;
        return 2;
    }
    PasswordCipher cipher;
    const QString password = cipher.decryptText(arguments.first(), Settings::PasswordKey);
    if (cipher.cryptoError() != PasswordCipher::NoError) {
        QTextStream(stderr) << cipher.cryptoErrorMessage() << Qt::endl;
        return 1;
    }
    QTextStream(stdout) << password << Qt::endl;
    return 0;
}

} // namespace PasswordVerbs
