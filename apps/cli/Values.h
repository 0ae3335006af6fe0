#ifndef VORL_APPS_CLI_VALUES_H
#define VORL_APPS_CLI_VALUES_H

/// @file
/// Texts of the command line as values, and values as text.
///
/// Every parser takes the option's name for its message and throws `UsageError`: "--size: '5' is
/// not WIDTHxHEIGHT (two whole numbers from 1 to 32767)".

#include <study/Vec3.h>

#include <string>
#include <vector>

namespace cli {

/// A finite number, decimal point and exponent as usual, whatever the user's language.
double ParseNumber(const std::string& option, const std::string& text);

/// A number from `minimum` to `maximum`; `what` names the range in the message.
double ParseNumberIn(const std::string& option, const std::string& text, double minimum,
                     double maximum);

/// A number greater than 0.
double ParsePositive(const std::string& option, const std::string& text);

/// A whole number from `minimum` to `maximum`.
int ParseWhole(const std::string& option, const std::string& text, int minimum, int maximum);

/// "X,Y,Z".
study::Vec3 ParseTriple(const std::string& option, const std::string& text);

/// `count` whole numbers from 1 to 32767 with "x" between them. `form` is what the message asks
/// for, such as "WIDTHxHEIGHT".
std::vector<int> ParseSize(const std::string& option, const std::string& text, std::size_t count,
                           const std::string& form);

/// True for `count` runs of digits with "x" between them, whether or not `ParseSize` takes them.
bool LooksLikeSize(const std::string& text, std::size_t count);

/// The numbers of "1,2.5,-3"; empty when the text is anything else.
std::vector<double> SplitNumbers(const std::string& text);

/// A number as people write it: up to ten digits, no trailing zeros.
std::string NumberText(double value);

/// A position in millimetres to the tenth of a micrometre, without trailing zeros.
std::string PositionText(double millimetres);

/// A number with so many decimals, and never a negative zero.
std::string FixedText(double value, int decimals);

/// The decimals that tell numbers apart whose distance is `step`, which is greater than 0: 0 from
/// whole numbers on, 9 at most.
int DecimalsFor(double step);

/// A length that was kept in single precision: "0.7" rather than "0.699999988", but all nine
/// digits of 0.451171875, which single precision holds exactly.
std::string LengthText(double value);

}  // namespace cli

#endif
