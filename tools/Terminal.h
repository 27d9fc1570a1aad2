#pragma once

#include <termios.h>

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace kelvo {

/// The whole screen of a terminal: drawn on its alternate screen, without a cursor, keys unechoed. Destruction brings
/// back what the user had. Main thread only; draws block as long as the terminal does.
class Terminal {
public:
    struct Size {
        std::size_t rows;
        std::size_t columns;
    };

    /// Takes the screen over; the descriptors stay the caller's. `input` may be something else than a terminal.
    Terminal(int input, int output);
    ~Terminal();
    Terminal(const Terminal&) = delete;
    Terminal& operator=(const Terminal&) = delete;

    /// Takes the screen over again after `leave`; the next draw writes every row.
    void enter();
    /// Gives the screen back. Idempotent.
    void leave();

    Size size() const;
    /// Forgets what stands on the screen, after a change of its size: the next draw writes every row.
    void forget();
    enum class Look { Plain, Faint, Reverse };
    struct Row {
        std::string text;
        Look look = Look::Plain;  ///< a terminal that knows no faint letters draws plain ones
    };
    /// Shows one row a line from the top. Rows are clipped at the screen's edge; only rows that changed are written.
    void draw(const std::vector<Row>& rows);

private:
    void write(std::string_view text) const;

    const int _input;
    const int _output;
    std::optional<termios> _before;  // none when the input is no terminal
    bool _entered = false;
    std::vector<std::string> _shown;
};

}  // namespace kelvo
