#pragma once

#include <locale>

/// Makes everything that obeys the global locale write "1.234,5", for as long as it lives.
class ForeignLocale
{
public:
    ForeignLocale() : mBefore(std::locale::global(std::locale(std::locale::classic(), new CommaPunctuation))) {}
    ForeignLocale(const ForeignLocale&) = delete;
    ForeignLocale& operator=(const ForeignLocale&) = delete;
    ~ForeignLocale() { std::locale::global(mBefore); }

private:
    class CommaPunctuation : public std::numpunct<char>
    {
        char do_decimal_point() const override { return ','; }
        char do_thousands_sep() const override { return '.'; }
        std::string do_grouping() const override { return "\3"; }
    };

    std::locale mBefore;
};
