// Writes the shipped color books: the ISCC-NBS centroids from the library's catalogue, and the CIE
// test color samples from a colord "CIE-TCS.sp" reference file.
//   pigmo_make_palettes <CIE-TCS.sp> <output folder>

#include <pigmo/bp.h>

#include <cctype>
#include <cstdio>
#include <fstream>
#include <iostream>
#include <sstream>
#include <string>
#include <vector>

namespace {

constexpr const char* kHeader =
    "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
    "<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v2\">\n";

std::string Escaped(const std::string& text) {
    std::string out;
    for (const char c : text) {
        switch (c) {
            case '&':
                out += "&amp;";
                break;
            case '<':
                out += "&lt;";
                break;
            case '>':
                out += "&gt;";
                break;
            case '"':
                out += "&quot;";
                break;
            default:
                out += c;
        }
    }
    return out;
}

std::string Number(double value, const char* format) {
    char text[64];
    std::snprintf(text, sizeof text, format, value);
    return text;
}

void WriteCustomAttribute(std::ostream& out, const char* name, const std::vector<std::string>& values) {
    out << "        <CxF:CustomAttribute>\n"
        << "          <CxF:Name>" << name << "</CxF:Name>\n"
        << "          <CxF:ValueChoice>\n";
    for (const std::string& value : values)
        out << "            <CxF:StringValue>" << Escaped(value) << "</CxF:StringValue>\n";
    out << "          </CxF:ValueChoice>\n"
        << "        </CxF:CustomAttribute>\n";
}

void WriteIsccNbs(std::ostream& out) {
    out << kHeader << "  <CxF:FileInformation>\n"
        << "    <CxF:Description>ISCC-NBS centroid colors: CIELAB (D50) and sRGB (from CIELAB) of the 267 "
           "centroids of the ISCC-NBS color-name blocks</CxF:Description>\n"
        << "  </CxF:FileInformation>\n"
        << "  <CxF:Palette PaletteName=\"ISCC-NBS Centroid Colors\">\n";
    const int categories = BPCentroidGetCategoryCount();
    for (int category = 1; category <= categories; ++category) {
        const std::string categoryName = BPCentroidGetCategoryName(category);
        out << "    <CxF:ColorSet Name=\"" << Escaped(categoryName) << "\">\n";
        for (int centroid = 1; centroid <= BPCentroidGetCount(); ++centroid) {
            if (BPCentroidGetCategory(centroid) != category) continue;
            const std::string name = BPCentroidGetName(centroid);
            const double* lab = BPCentroidGetLab(centroid);
            double rgb[3] = {0, 0, 0};
            BPConvertLab2sRGB(lab, rgb);

            // Tags: the name's words, for searching by hue or modifier, and the centroid number.
            std::vector<std::string> tags;
            std::istringstream words(name);
            for (std::string word; words >> word;) {
                for (char& c : word) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
                tags.push_back(word);
            }
            tags.push_back("centroid " + std::to_string(centroid));

            out << "      <CxF:Color ColorName=\"" << Escaped(name) << "\">\n";
            WriteCustomAttribute(out, "category", {categoryName});
            WriteCustomAttribute(out, "tags", tags);
            out << "        <CxF:ColorSpaceCIELab>\n"
                << "          <CxF:L>" << Number(lab[0], "%.10g") << "</CxF:L>\n"
                << "          <CxF:A>" << Number(lab[1], "%.10g") << "</CxF:A>\n"
                << "          <CxF:B>" << Number(lab[2], "%.10g") << "</CxF:B>\n"
                << "        </CxF:ColorSpaceCIELab>\n"
                << "        <CxF:ColorSpaceSRGB>\n"
                << "          <CxF:Red>" << Number(rgb[0] / 255.0, "%.6f") << "</CxF:Red>\n"
                << "          <CxF:Green>" << Number(rgb[1] / 255.0, "%.6f") << "</CxF:Green>\n"
                << "          <CxF:Blue>" << Number(rgb[2] / 255.0, "%.6f") << "</CxF:Blue>\n"
                << "        </CxF:ColorSpaceSRGB>\n"
                << "      </CxF:Color>\n";
        }
        out << "    </CxF:ColorSet>\n";
    }
    out << "  </CxF:Palette>\n</CxF:CxF>\n";
}

struct Sample {
    std::string id;
    std::vector<std::string> values;  // as the reference file prints them
};

struct SampleNotes {
    const char* category;
    const char* munsell;
    const char* description;
};

// Munsell notation and description of each sample; sample 15 is the later addition of JIS Z 8726.
constexpr SampleNotes kNotes[15] = {
    {"General (Ra)", "7.5 R 6/4", "light greyish red"},
    {"General (Ra)", "5 Y 6/4", "dark greyish yellow"},
    {"General (Ra)", "5 GY 6/8", "strong yellow green"},
    {"General (Ra)", "2.5 G 6/6", "moderate yellowish green"},
    {"General (Ra)", "10 BG 6/4", "light bluish green"},
    {"General (Ra)", "5 PB 6/8", "light blue"},
    {"General (Ra)", "2.5 P 6/8", "light violet"},
    {"General (Ra)", "10 P 6/8", "light reddish purple"},
    {"Special", "4.5 R 4/13", "strong red"},
    {"Special", "5 Y 8/10", "strong yellow"},
    {"Special", "4.5 G 5/8", "strong green"},
    {"Special", "3 PB 3/11", "strong blue"},
    {"Special", "5 YR 8/4", "light yellowish pink"},
    {"Special", "5 GY 4/4", "moderate olive green"},
    {"Special", "1 YR 6/4", "skin"},
};

// Reads the samples of a colord spectral file, keeping the 36 bands 380 to 730 nm by 10 nm.
bool ReadSamples(const char* path, std::vector<Sample>& samples) {
    std::ifstream in(path);
    if (!in) return false;
    double start = 0, end = 0;
    int bands = 0;
    bool inData = false;
    for (std::string line; std::getline(in, line);) {
        std::istringstream fields(line);
        std::string key;
        fields >> key;
        if (key == "SPECTRAL_START_NM")
            fields >> start;
        else if (key == "SPECTRAL_END_NM")
            fields >> end;
        else if (key == "SPECTRAL_BANDS")
            fields >> bands;
        else if (key == "BEGIN_DATA")
            inData = true;
        else if (key == "END_DATA")
            inData = false;
        else if (inData && !key.empty()) {
            std::vector<std::string> values;
            for (std::string value; fields >> value;) values.push_back(value);
            if (bands < 2 || static_cast<int>(values.size()) != bands) return false;
            const double step = (end - start) / (bands - 1);
            Sample sample{key, {}};
            for (int nm = 380; nm <= 730; nm += 10) {
                const double index = (nm - start) / step;
                const int band = static_cast<int>(index + 0.5);
                if (index < 0 || band >= bands || index != band) return false;
                sample.values.push_back(values[static_cast<std::size_t>(band)]);
            }
            samples.push_back(std::move(sample));
        }
    }
    return samples.size() == std::size(kNotes);
}

void WriteTestColorSamples(std::ostream& out, const std::vector<Sample>& samples) {
    out << kHeader << "  <CxF:FileInformation>\n"
        << "    <CxF:Description>CIE test color samples: spectral reflectance, 380 to 730 nm by 10 nm"
           "</CxF:Description>\n"
        << "  </CxF:FileInformation>\n"
        << "  <CxF:Palette PaletteName=\"CIE Test Color Samples\">\n"
        << "    <CxF:ColorSet>\n";
    for (std::size_t i = 0; i < samples.size(); ++i) {
        const SampleNotes& notes = kNotes[i];
        out << "      <CxF:Color ColorName=\"" << samples[i].id << "\">\n";
        WriteCustomAttribute(out, "category", {notes.category});
        WriteCustomAttribute(out, "tags",
                             {i < 14 ? "CIE 13.3" : "JIS Z 8726", notes.munsell, notes.description});
        out << "        <CxF:ColorSpaceSpectral>\n";
        for (std::size_t band = 0; band < samples[i].values.size(); ++band)
            out << "          <CxF:ReflectancePoint Wavelength=\"" << 380 + 10 * band << "\">"
                << samples[i].values[band] << "</CxF:ReflectancePoint>\n";
        out << "        </CxF:ColorSpaceSpectral>\n"
            << "      </CxF:Color>\n";
    }
    out << "    </CxF:ColorSet>\n  </CxF:Palette>\n</CxF:CxF>\n";
}

bool WriteBook(const std::string& path, const std::string& content) {
    std::ofstream out(path, std::ios::binary);
    out << content;
    return static_cast<bool>(out.flush());
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 3) {
        std::cerr << "usage: pigmo_make_palettes <CIE-TCS.sp> <output folder>\n";
        return 2;
    }
    std::vector<Sample> samples;
    if (!ReadSamples(argv[1], samples)) {
        std::cerr << "pigmo_make_palettes: " << argv[1]
                  << ": not a spectral file with the 15 test color samples\n";
        return 1;
    }
    const std::string folder = std::string(argv[2]) + "/";
    std::ostringstream iscc, tcs;
    WriteIsccNbs(iscc);
    WriteTestColorSamples(tcs, samples);
    for (const auto& [name, book] :
         {std::pair{"ISCC-NBS Centroid Colors.cxf", &iscc}, std::pair{"Test Color Samples.cxf", &tcs}}) {
        if (!WriteBook(folder + name, book->str())) {
            std::cerr << "pigmo_make_palettes: cannot write " << folder + name << "\n";
            return 1;
        }
    }
    return 0;
}
