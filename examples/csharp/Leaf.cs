using System;
using HqfV2;

// A colour of two forms: CIELAB values and the spectrum that they are computed from.
static class Leaf {
    // Reflectance factors from 380 to 730 nm, CIE 13.3.
    static readonly double[] reflectances = { 0.036, 0.037, 0.039, 0.040, 0.042, 0.043, 0.044, 0.045, 0.047,
                                              0.050, 0.055, 0.062, 0.075, 0.092, 0.108, 0.133, 0.150, 0.155,
                                              0.147, 0.133, 0.118, 0.106, 0.098, 0.093, 0.089, 0.086, 0.084,
                                              0.084, 0.085, 0.092, 0.102, 0.123, 0.152, 0.188, 0.226, 0.260 };
    const double firstNm = 380, stepNm = 10;

    // The conditions of measurement are nil, because the palette states them for all. They must be there all the same:
    // a form without them is incomplete, and writing the document would be refused.
    internal static void Fill(ColorType leaf) {
        DateTimeOffset now = DateTimeOffset.UtcNow;
        leaf.ColorName = "Olive green leaf";
        leaf.ColorNumber = "25";
        leaf.ChangeHistories.Add(now);

        ColorSpaceCIELabType lab = leaf.ColorSpaces.Add().ChooseColorSpaceCIELab();
        lab.ChangeHistories.Add(now);
        lab.ColorSpaceSpecificationSpectrumTristimulus.SetNil();
        lab.L = 40.79;
        lab.A = -12.39;
        lab.B = 24.06;

        ColorSpaceSpectralType spectrum = leaf.ColorSpaces.Add().ChooseColorSpaceSpectral();
        spectrum.ChangeHistories.Add(now);
        spectrum.ColorSpaceSpecificationSpectrumSpectral.SetNil();
        for (int i = 0; i < reflectances.Length; ++i) {
            ReflectancePointType point = spectrum.ReflectancePoints.Add();
            point.Wavelength = firstNm + i * stepNm;
            point.Value = reflectances[i];
        }
    }
}
