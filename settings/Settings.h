#pragma once

#include <QByteArray>
#include <QString>

// The label of the user's side of the tally when the system knows no name.
inline const QString kDefaultOwnerName = QStringLiteral("You");

// The owner's name from a passwd GECOS field: the text up to its first comma,
// trimmed; "You" when that is empty.
QString OwnerNameFromGecos(const QByteArray& gecos);

// The name of the account the program runs under, or "You".
QString SystemOwnerName();
