// The parts that a PNG file is made of.
#pragma once

#include "cli/film_writer.h"
#include "cli/out_file.h"

#define ZLIB_CONST // what is packed is only read
#include <zlib.h>

/// How pixels stand in a file: the number of a colour, or its three parts where there are too many.
class PngPixels {
  public:
    explicit PngPixels(const Colours& colours) : colours_(colours) {}

    /// The file's first bytes, up to where the pictures begin, of one of this size. What
    /// `animation` holds stands behind the header.
    Bytes head(int width, int height, const Bytes& animation) const;

    /// The rows of an area as they stand in a file before they are compressed.
    void rowsOf(const seam::PixelView& picture, const RECT& area, Bytes& rows) const;

  private:
    const Colours& colours_;
};

void AppendNumber(Bytes& bytes, std::uint32_t number);
void AppendShort(Bytes& bytes, std::uint32_t number);

/// Appends a chunk: its length, its name of four letters, its content and its check sum.
void AppendChunk(Bytes& bytes, const char* name, const Bytes& content);

/// The last chunk of a file.
void AppendEnd(Bytes& bytes);

/// Compresses, again and again, without making its tables anew.
class Packer {
  public:
    /// With a header and a check sum round what is packed, as a whole stream, or without.
    enum class Form { stream, part };

    explicit Packer(Form form);
    Packer(const Packer&) = delete;
    Packer& operator=(const Packer&) = delete;
    ~Packer();

    /// Appends the packed bytes. A part ends at a whole byte, another part or the end of a stream
    /// may stand behind it.
    void append(Bytes& packed, const Bytes& bytes);

  private:
    z_stream stream_{};
    Form form_;
};
