#!/usr/bin/env python3
"""Writes the sample DICOM documents of examples/dicom from the DICOM standard's UID table as
Debian ships it (libdcmtk-dev's dcuid.h), so that no UID is ever typed by hand:

  examples/dicom/SOPServiceConfiguration.xml  transfer syntaxes, templates and storage services
  examples/dicom/DicomClient.xml              the SOP classes the viewing client may display
  tests/data/dicom/StandardUids.txt           every UID of the table ("NAME UID" per line), for
                                              the test that checks the samples against it

Usage: scripts/make-dicom-samples.py [PATH_TO_dcuid.h]
"""
import os
import re
import sys
from xml.sax.saxutils import escape

ROOT = os.path.dirname(os.path.dirname(os.path.abspath(__file__)))
HEADER = sys.argv[1] if len(sys.argv) > 1 else "/usr/include/dcmtk/dcmdata/dcuid.h"

# Transfer syntaxes in table order: (number, UID macro without "UID_", display name).
SYNTAXES = [
    (1, "LittleEndianImplicitTransferSyntax", "Implicit VR Little Endian"),
    (2, "LittleEndianExplicitTransferSyntax", "Explicit VR Little Endian"),
    (3, "BigEndianExplicitTransferSyntax", "Explicit VR Big Endian"),
    (4, "DeflatedExplicitVRLittleEndianTransferSyntax", "Deflated Explicit VR Little Endian"),
    (5, "JPEGProcess1TransferSyntax", "JPEG Baseline (Process 1)"),
    (6, "JPEGProcess2_4TransferSyntax", "JPEG Extended (Process 2 & 4)"),
    (7, "JPEGProcess14TransferSyntax", "JPEG Lossless, Non-Hierarchical (Process 14)"),
    (8, "JPEGProcess14SV1TransferSyntax", "JPEG Lossless, First-Order Prediction (Process 14 SV1)"),
    (9, "JPEGLSLosslessTransferSyntax", "JPEG-LS Lossless"),
    (10, "JPEGLSLossyTransferSyntax", "JPEG-LS Lossy (Near-Lossless)"),
    (11, "JPEG2000LosslessOnlyTransferSyntax", "JPEG 2000 (Lossless Only)"),
    (12, "JPEG2000TransferSyntax", "JPEG 2000"),
    (13, "JPEG2000Part2MulticomponentImageCompressionLosslessOnlyTransferSyntax",
     "JPEG 2000 Part 2 Multi-component (Lossless Only)"),
    (14, "JPEG2000Part2MulticomponentImageCompressionTransferSyntax",
     "JPEG 2000 Part 2 Multi-component"),
    (15, "JPIPReferencedTransferSyntax", "JPIP Referenced"),
    (16, "JPIPReferencedDeflateTransferSyntax", "JPIP Referenced Deflate"),
    (17, "RLELosslessTransferSyntax", "RLE Lossless"),
    (18, "MPEG2MainProfileAtMainLevelTransferSyntax", "MPEG2 Main Profile @ Main Level"),
    (19, "MPEG2MainProfileAtHighLevelTransferSyntax", "MPEG2 Main Profile @ High Level"),
    (20, "MPEG4HighProfileLevel4_1TransferSyntax", "MPEG-4 AVC/H.264 High Profile / Level 4.1"),
    (21, "MPEG4BDcompatibleHighProfileLevel4_1TransferSyntax",
     "MPEG-4 AVC/H.264 BD-compatible High Profile / Level 4.1"),
    (22, "MPEG4HighProfileLevel4_2_For2DVideoTransferSyntax",
     "MPEG-4 AVC/H.264 High Profile / Level 4.2 For 2D Video"),
    (23, "MPEG4HighProfileLevel4_2_For3DVideoTransferSyntax",
     "MPEG-4 AVC/H.264 High Profile / Level 4.2 For 3D Video"),
    (24, "MPEG4StereoHighProfileLevel4_2TransferSyntax",
     "MPEG-4 AVC/H.264 Stereo High Profile / Level 4.2"),
    (25, "HEVCMainProfileLevel5_1TransferSyntax", "HEVC/H.265 Main Profile / Level 5.1"),
    (26, "HEVCMain10ProfileLevel5_1TransferSyntax", "HEVC/H.265 Main 10 Profile / Level 5.1"),
    (27, "RFC2557MIMEEncapsulationTransferSyntax", "RFC 2557 MIME Encapsulation"),
    (28, "XMLEncodingTransferSyntax", "XML Encoding"),
]

# Templates: (name, additional, numbers, description).
TEMPLATES = [
    ("Uncompressed", False, "1,2,3", "The three uncompressed encodings"),
    ("Lossless", False, "1,2,3,4,7,8,9,11,13,17", "Uncompressed and every lossless compression"),
    ("AllCompressed", False, "1,2,3,4,5,6,7,8,9,10,11,12,13,14,15,16,17",
     "Uncompressed and every still-image compression"),
    ("Lossy", False, "1,2,5,6,10,12,14", "Uncompressed and the lossy compressions"),
    ("Video", False, "1,2,18,19,20,21,22,23,24,25,26", "Uncompressed and the video encodings"),
    ("Documents", False, "1;2;4", "Uncompressed and deflated"),
    ("Uncompressed", True, "2,1", "Explicit first: for the additional services"),
    ("Lossless", True, "2 1 9 11", "Lossless for the additional services"),
]

# Storage services: (UID macro, display name, object type, default list, extra keys).
S = []


def service(macro, name, kind="IMAGE", default="AllCompressed", **extra):
    S.append((macro, name, kind, default, extra))


for macro, name in [
    ("ComputedRadiographyImageStorage", "Computed Radiography Image Storage"),
    ("DigitalXRayImageStorageForPresentation", "Digital X-Ray Image Storage - For Presentation"),
    ("DigitalXRayImageStorageForProcessing", "Digital X-Ray Image Storage - For Processing"),
    ("DigitalMammographyXRayImageStorageForPresentation",
     "Digital Mammography X-Ray Image Storage - For Presentation"),
    ("DigitalMammographyXRayImageStorageForProcessing",
     "Digital Mammography X-Ray Image Storage - For Processing"),
    ("DigitalIntraOralXRayImageStorageForPresentation",
     "Digital Intra-Oral X-Ray Image Storage - For Presentation"),
    ("DigitalIntraOralXRayImageStorageForProcessing",
     "Digital Intra-Oral X-Ray Image Storage - For Processing"),
    ("CTImageStorage", "CT Image Storage"),
    ("EnhancedCTImageStorage", "Enhanced CT Image Storage"),
    ("LegacyConvertedEnhancedCTImageStorage", "Legacy Converted Enhanced CT Image Storage"),
    ("MRImageStorage", "MR Image Storage"),
    ("EnhancedMRImageStorage", "Enhanced MR Image Storage"),
    ("EnhancedMRColorImageStorage", "Enhanced MR Color Image Storage"),
    ("LegacyConvertedEnhancedMRImageStorage", "Legacy Converted Enhanced MR Image Storage"),
    ("XRayAngiographicImageStorage", "X-Ray Angiographic Image Storage"),
    ("EnhancedXAImageStorage", "Enhanced XA Image Storage"),
    ("XRayRadiofluoroscopicImageStorage", "X-Ray Radiofluoroscopic Image Storage"),
    ("EnhancedXRFImageStorage", "Enhanced XRF Image Storage"),
    ("XRay3DAngiographicImageStorage", "X-Ray 3D Angiographic Image Storage"),
    ("BreastTomosynthesisImageStorage", "Breast Tomosynthesis Image Storage"),
    ("NuclearMedicineImageStorage", "Nuclear Medicine Image Storage"),
    ("PositronEmissionTomographyImageStorage", "Positron Emission Tomography Image Storage"),
    ("EnhancedPETImageStorage", "Enhanced PET Image Storage"),
    ("LegacyConvertedEnhancedPETImageStorage", "Legacy Converted Enhanced PET Image Storage"),
    ("SecondaryCaptureImageStorage", "Secondary Capture Image Storage"),
    ("MultiframeTrueColorSecondaryCaptureImageStorage",
     "Multi-frame True Color Secondary Capture Image Storage"),
    ("VLPhotographicImageStorage", "VL Photographic Image Storage"),
    ("OphthalmicPhotography8BitImageStorage", "Ophthalmic Photography 8 Bit Image Storage"),
    ("SegmentationStorage", "Segmentation Storage"),
    ("RTImageStorage", "RT Image Storage"),
]:
    service(macro, name, default="Lossless" if "Mammography" in macro else "AllCompressed")

for macro, name in [
    ("UltrasoundImageStorage", "Ultrasound Image Storage"),
    ("UltrasoundMultiframeImageStorage", "Ultrasound Multi-frame Image Storage"),
    ("EnhancedUSVolumeStorage", "Enhanced US Volume Storage"),
]:
    service(macro, name, default="Lossy")
service("VideoEndoscopicImageStorage", "Video Endoscopic Image Storage", default="Video")
service("VideoPhotographicImageStorage", "Video Photographic Image Storage", default="Video",
        TxList="18,20,2")
service("MultiframeGrayscaleByteSecondaryCaptureImageStorage",
        "Multi-frame Grayscale Byte Secondary Capture Image Storage", default="AllCompressed",
        TxList="1,2,5,17")
service("MultiframeGrayscaleWordSecondaryCaptureImageStorage",
        "Multi-frame Grayscale Word Secondary Capture Image Storage", default="Lossless",
        TxList="1 2 9")

for macro, name in [
    ("RTDoseStorage", "RT Dose Storage"),
    ("RTStructureSetStorage", "RT Structure Set Storage"),
    ("RTPlanStorage", "RT Plan Storage"),
    ("RTBeamsTreatmentRecordStorage", "RT Beams Treatment Record Storage"),
    ("RTBrachyTreatmentRecordStorage", "RT Brachy Treatment Record Storage"),
    ("RTTreatmentSummaryRecordStorage", "RT Treatment Summary Record Storage"),
    ("RTIonPlanStorage", "RT Ion Plan Storage"),
    ("RTIonBeamsTreatmentRecordStorage", "RT Ion Beams Treatment Record Storage"),
    ("SpatialRegistrationStorage", "Spatial Registration Storage"),
    ("SpatialFiducialsStorage", "Spatial Fiducials Storage"),
    ("RealWorldValueMappingStorage", "Real World Value Mapping Storage"),
]:
    service(macro, name, default="1,2,4")

for macro, name in [
    ("BasicTextSRStorage", "Basic Text SR Storage"),
    ("EnhancedSRStorage", "Enhanced SR Storage"),
    ("ComprehensiveSRStorage", "Comprehensive SR Storage"),
    ("Comprehensive3DSRStorage", "Comprehensive 3D SR Storage"),
    ("ProcedureLogStorage", "Procedure Log Storage"),
    ("MammographyCADSRStorage", "Mammography CAD SR Storage"),
    ("ChestCADSRStorage", "Chest CAD SR Storage"),
    ("XRayRadiationDoseSRStorage", "X-Ray Radiation Dose SR Storage"),
]:
    service(macro, name, kind="SR", default="Documents")
service("RadiopharmaceuticalRadiationDoseSRStorage",
        "Radiopharmaceutical Radiation Dose SR Storage", kind="SR", default="Documents",
        Additional="1", EnabledDefault="0")
service("KeyObjectSelectionDocumentStorage", "Key Object Selection Document Storage", kind="KO",
        default="Documents")
service("GrayscaleSoftcopyPresentationStateStorage",
        "Grayscale Softcopy Presentation State Storage", kind="GSPS", default="Uncompressed",
        Additional="1")
service("ColorSoftcopyPresentationStateStorage", "Color Softcopy Presentation State Storage",
        kind="CSPS", default="Uncompressed", Additional="1")
service("PseudoColorSoftcopyPresentationStateStorage",
        "Pseudo-Color Softcopy Presentation State Storage", kind="CSPS", default="Uncompressed",
        Additional="1", Enabled="0")
service("BlendingSoftcopyPresentationStateStorage",
        "Blending Softcopy Presentation State Storage", kind="CSPS", default="Lossless",
        Additional="1", TxList="")
service("XAXRFGrayscaleSoftcopyPresentationStateStorage",
        "XA/XRF Grayscale Softcopy Presentation State Storage", kind="GSPS",
        default="Uncompressed", Additional="1", TxList="2")
service("EncapsulatedPDFStorage", "Encapsulated PDF Storage", kind="SPECIAL", default="Documents")
service("EncapsulatedCDAStorage", "Encapsulated CDA Storage", kind="SPECIAL", default="1,2")
service("RawDataStorage", "Raw Data Storage", kind="PRIVATE", default="1, 2, 3")
service("TwelveLeadECGWaveformStorage", "12-lead ECG Waveform Storage", default="1,2",
        EnabledDefault="0")
service("GeneralECGWaveformStorage", "General ECG Waveform Storage", default="1,2",
        EnabledDefault="0", Enabled="1")
service("HangingProtocolStorage", "Hanging Protocol Storage", default="Uncompressed")

FILTER_TAGS = [
    ("0008,0060", "Modality", None, None, False),
    ("0018,0015", "Body Part Examined", None, None, False),
    ("0008,1030", "Study Description", None, None, False),
    ("0040,A043", "Concept Name Code Sequence", "BasicTextSRStorage", "Basic Text SR Storage",
     False),
    ("0070,0080", "Content Label", "GrayscaleSoftcopyPresentationStateStorage",
     "Grayscale Softcopy Presentation State Storage", True),
]

VIEWABLE = [m for m, _, kind, _, _ in S if kind in ("IMAGE", "GSPS", "CSPS", "KO", "SR")][:48]


def read_table(path):
    table = {}
    with open(path, encoding="latin-1") as header:
        for line in header:
            match = re.match(r'#define UID_(\w+)\s+"([0-9.]+)"', line)
            if match:
                table[match.group(1)] = match.group(2)
    return table


class Xml:
    def __init__(self):
        self.lines = ['<?xml version="1.0" encoding="ISO-8859-1"?>']
        self.depth = 0

    def open(self, key):
        self.lines.append("  " * self.depth + '<e k="%s">' % key)
        self.lines.append("  " * (self.depth + 1) + "<l>")
        self.depth += 2

    def close(self):
        self.depth -= 2
        self.lines.append("  " * (self.depth + 1) + "</l>")
        self.lines.append("  " * self.depth + "</e>")

    def text(self, key, value):
        self.lines.append("  " * self.depth + '<e k="%s"><s>%s</s></e>' % (key, escape(value)))

    def write(self, path):
        with open(path, "w", encoding="latin-1") as out:
            out.write("\n".join(self.lines) + "\n")


def sop_services(table):
    x = Xml()
    x.open("SOPServiceConfiguration")
    x.text("ReleaseDate", "2023-01-15")
    x.text("Version", "12")
    x.text("Description", "Storage services of the archive and the transfer syntaxes they accept")
    x.text("ProductVersion", "4.2.0")
    x.open("SupportedTxList")
    for nr, macro, name in SYNTAXES:
        x.open("SupportedTx")
        x.text("TxNr", str(nr))
        x.text("TxUID", table[macro])
        x.text("TxName", name)
        if nr <= 2:
            x.text("TxDescription", "Always offered")
        x.close()
    x.close()
    x.open("TemplateTxLists")
    for name, additional, numbers, description in TEMPLATES:
        x.open("TemplateTxList")
        x.text("TemplateName", name)
        x.text("TemplateDescription", description)
        if additional:
            x.text("Additional", "1")
        x.text("TxList", numbers)
        x.close()
    x.close()
    x.open("SOPServiceList")
    for macro, name, kind, default, extra in S:
        x.open("SOPService")
        x.text("UID", table[macro])
        x.text("Name", name)
        x.text("ObjectType", kind)
        for key in ("Additional", "EnabledDefault", "Enabled"):
            if key in extra:
                x.text(key, extra[key])
        x.text("TxListDefault", default)
        if "TxList" in extra:
            x.text("TxList", extra["TxList"])
        x.close()
    x.close()
    x.open("FilterTagList")
    for tag, tag_name, macro, class_name, additional in FILTER_TAGS:
        x.open("FilterTag")
        x.text("Tag", tag)
        x.text("TagName", tag_name)
        if macro:
            x.text("SOPClassUID", table[macro])
            x.text("SOPClassName", class_name)
        if additional:
            x.text("Additional", "1")
        x.close()
    x.close()
    x.close()
    return x


def dicom_client(table):
    names = {m: n for m, n, _, _, _ in S}
    x = Xml()
    x.open("DicomClient")
    x.open("ViewableSOPClasses")
    for macro in sorted(VIEWABLE, key=lambda m: table[m]):
        x.open("SOPClass")
        x.text("name", names[macro])
        x.text("uid", table[macro])
        x.close()
    x.close()
    x.close()
    return x


def main():
    table = read_table(HEADER)
    sop_services(table).write(os.path.join(ROOT, "examples/dicom/SOPServiceConfiguration.xml"))
    dicom_client(table).write(os.path.join(ROOT, "examples/dicom/DicomClient.xml"))
    with open(os.path.join(ROOT, "tests/data/dicom/StandardUids.txt"), "w") as out:
        for macro in sorted(table):
            out.write("%s %s\n" % (macro, table[macro]))


if __name__ == "__main__":
    main()
