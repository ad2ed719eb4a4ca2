#pragma once

#include <QString>

namespace ardcard::keys {

// Every key of the settings store (application "VL7Trans", section
// "Params") with the default a missing key reads as.
struct Key {
    const char16_t* name;
    const char16_t* fallback;
};

// Connection values, saved by the connection dialog.
inline constexpr Key ConnServer{u"ConnServer", u"server"};
inline constexpr Key ConnUID{u"ConnUID", u"sa"};
inline constexpr Key ConnPWD{u"ConnPWD", u""};
inline constexpr Key ConnDataBase{u"ConnDataBase", u"velmor02"};
inline constexpr Key ConnType{u"ConnType", u"0"}; // the dialog's list position, type - 1

// The card's options, saved by its save button.
inline constexpr Key CompanyDir{u"CompanyDir", u"demo.mdb"};
inline constexpr Key OnlyOpenTrans{u"OnlyOpenTrans", u"0"};
inline constexpr Key ReadNegdiName{u"ReadNegdiName", u"0"};
inline constexpr Key ShowHeadDetails{u"ShowHeadDetails", u"0"};
inline constexpr Key MainDrive{u"MainDrive", u""};
inline constexpr Key MainDir{u"MainDir", u""};

inline QString name(const Key& k) {
    return QString::fromUtf16(k.name);
}
inline QString fallback(const Key& k) {
    return QString::fromUtf16(k.fallback);
}

} // namespace ardcard::keys
