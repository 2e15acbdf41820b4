// The sub-command that makes a film of a show.
#pragma once

#include <string>
#include <vector>

/// toon film FILE.zkt OUT, or --walk-about OUT: acts a show out and keeps it as a film, or as one
/// picture with --still MS. What OUT ends in says the form (film_writer.h). Gives the exit code.
int FilmCommand(const std::vector<std::string>& line);
