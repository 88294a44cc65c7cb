#pragma once

#include <QLabel>

// Plain text of any length that takes the width it is given and as many lines as it needs.
class WrappedLabel : public QLabel {
 public:
    explicit WrappedLabel(const QString& name, QWidget* parent = nullptr) : QLabel(parent) {
        setObjectName(name);
        setTextFormat(Qt::PlainText);
        setWordWrap(true);
        // A long path without blanks does not make the window wider.
        QSizePolicy policy = sizePolicy();
        policy.setHorizontalPolicy(QSizePolicy::Ignored);
        setSizePolicy(policy);
    }
};
