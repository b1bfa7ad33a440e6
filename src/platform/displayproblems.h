#pragma once

/// Where no display can be opened, the process ends with 1: one line of the program's own on
/// standard error, then what the toolkit says of it. The toolkit itself would abort. So as long as
/// one lives, what the toolkit reports is held back; when there is a display after all, it is
/// handed on. One at a time.
class DisplayProblems {
public:
    explicit DisplayProblems(const char *program);
    DisplayProblems(const DisplayProblems &) = delete;
    DisplayProblems &operator=(const DisplayProblems &) = delete;
    ~DisplayProblems();
};
