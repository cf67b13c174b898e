/// The library's main job on a real document: loads the measured colours of a rendition chart, prints them, adds a
/// colour and changes the header, writes the document, loads it again and tells what changed.
///
/// usage: rendition_chart CHART.hqf NEW.hqf

#include <cerrno>
#include <cstring>
#include <ctime>
#include <filesystem>
#include <iostream>

#include <unistd.h>

#include "colour_table.h"
#include "hqf/values/text.h"
#include "hqf/xml_in/c_xml_reader_file.h"
#include "leaf.h"

using namespace hqf_v2;

namespace {

std::wstring wide(const std::string& text) {
    std::wstring out;
    return lmx::convert(&out, text);
}

std::string outcome(lmx::elmx_error code) {
    return std::to_string(code) + " (" + lmx::get_error_description(code) + ")";
}

/// Loads through a reader of our own, which knows where a document is wrong; loadFile() gives the code alone.
bool load(Hqf& document, const char* path) {
    lmx::c_xml_reader_file reader(path);
    if (!reader.is_open()) {
        std::cerr << path << ": " << std::strerror(errno) << '\n';
        return false;
    }
    const lmx::elmx_error code = document.unmarshal(reader);
    if (code == lmx::err_no_error) return true;
    std::string message;
    std::cerr << path << ": " << reader.get_error_message(&message) << " [" << code << "]\n";
    return false;
}

void print(const Hqf& document, colour_table& table) {
    for (unsigned int p = 0; p < document.size_Palette(); ++p) {
        const PaletteType& palette = document.get_Palette(p);
        std::cout << narrow(palette.get_PaletteName()) << ": " << narrow(palette.get_Comments()) << '\n'
                  << conditions(palette) << '\n';
        table.heading();
        for (unsigned int s = 0; s < palette.size_ColorSet(); ++s)
            table.colour_set(palette.get_ColorSet(s));
    }
}

lmx::c_datetime now_utc() {
    const std::time_t now = std::time(nullptr);
    std::tm utc{};
    gmtime_r(&now, &utc);
    char text[32];
    std::strftime(text, sizeof text, "%Y-%m-%dT%H:%M:%SZ", &utc);
    return lmx::c_datetime(text);
}

void edit(Hqf& document) {
    const lmx::c_datetime when = now_utc();
    Header& header = document.get_Preamble().get_Header();
    must(header.set_Name(L"Colour rendition chart with a leaf"));
    must(header.set_Purpose(L"Demonstration"));
    must(header.append_ChangeHistory(when));
    ColorSetType& natural_colours = document.get_Palette(0).get_ColorSet(0);
    must(natural_colours.append_Color());
    fill_leaf(natural_colours.back_Color(), when);
}

void print_change(const char* what, const std::string& before, const std::string& after) {
    if (before != after) std::cout << "  " << what << ": " << before << "  ->  " << after << '\n';
}

std::string history_text(const Header& header) {
    const unsigned int size = header.size_ChangeHistory();
    return std::to_string(size) + (size == 1 ? " entry, " : " entries, the last ") +
           header.get_ChangeHistory(size - 1).get_as_string();
}

/// Tells what differs between two documents of the same palettes and colour sets.
void print_changes(const Hqf& before, const Hqf& after, colour_table& table) {
    const Header& old_header = before.get_Preamble().get_Header();
    const Header& new_header = after.get_Preamble().get_Header();
    std::cout << "\nWhat changed in the file\n\n";
    print_change("Name", narrow(old_header.get_Name()), narrow(new_header.get_Name()));
    print_change("Purpose", narrow(old_header.get_Purpose()), narrow(new_header.get_Purpose()));
    print_change("ChangeHistory", history_text(old_header), history_text(new_header));
    unsigned int same = 0;
    for (unsigned int s = 0; s < after.get_Palette(0).size_ColorSet(); ++s) {
        const ColorSetType& old_set = before.get_Palette(0).get_ColorSet(s);
        const ColorSetType& new_set = after.get_Palette(0).get_ColorSet(s);
        print_change(narrow(new_set.get_ColorSetName()).c_str(), std::to_string(old_set.size_Color()) + " colours",
                     std::to_string(new_set.size_Color()) + " colours");
        for (unsigned int i = 0; i < new_set.size_Color(); ++i)
            if (i < old_set.size_Color() && hqf::equal(old_set.get_Color(i), new_set.get_Color(i)))
                ++same;
            else
                table.row(new_set.get_Color(i));
    }
    std::cout << "  " << same << " colours are as they were\n";
}

int run(const char* chart_path, const char* new_path) {
    Hqf document;
    if (!load(document, chart_path)) return 1;
    const Hqf original = document; // a deep copy, to compare with
    colour_table table(std::cout, isatty(STDOUT_FILENO) == 1);
    print(document, table);

    edit(document);
    const lmx::elmx_error written = document.writeFile(wide(new_path));
    if (written != lmx::err_no_error) {
        std::cerr << new_path << " can't be written: " << outcome(written) << '\n';
        return 1;
    }
    Hqf reloaded;
    if (!load(reloaded, new_path)) return 1;
    print_changes(original, reloaded, table);
    std::cout << "  " << std::filesystem::file_size(chart_path) << "  ->  " << std::filesystem::file_size(new_path)
              << " bytes; writing gave " << outcome(written) << '\n';
    if (!hqf::equal(document, reloaded)) {
        std::cerr << new_path << " holds another document than the one that was written\n";
        return 1;
    }
    std::cout << "  Loaded again, the document equals the one in memory: " << new_path << '\n';
    return 0;
}

} // namespace

int main(int argc, char** argv) {
    if (argc != 3) {
        std::cerr << "usage: rendition_chart CHART.hqf NEW.hqf\n";
        return 2;
    }
    try {
        return run(argv[1], argv[2]);
    } catch (const lmx::c_lmx_exception& error) {
        std::cerr << "A value was refused: " << outcome(error.get_error()) << '\n';
    } catch (const std::exception& error) {
        std::cerr << error.what() << '\n';
    }
    return 1;
}
