' A sweep in a picture, without any form.
' Start: regsvr32 frontpanels.ocx, then  cscript //nologo sweep.vbs C:\Temp\sweep.png
' A carrier is put into noise, a marker on its peak. The last line says that the script came to its end:
' a script host that fails in between ends with status 0 all the same.
Option Explicit
Const SpectrumPath = "Brantor Scanner/Spectrum/Spectrum Trace"
Dim panel, hub, levels(512), i

If WScript.Arguments.Count <> 1 Then
  WScript.Echo "usage: cscript //nologo sweep.vbs PICTURE.png"
  WScript.Quit 2
End If

Set hub = CreateObject("FrontPanels.DataHub")
Set panel = CreateObject("FrontPanels.SpectrumView")
panel.vfpSet 0, 314, 0, "Receiver 1"   ' caption
panel.vfpSet 0, 13, 0, 881520000       ' centre in Hz
panel.vfpSet 0, 14, 0, 1250000         ' span in Hz
panel.ViewWidth = 14400                ' twips: 960 pixels at 96 dots an inch
panel.ViewHeight = 9000

Randomize 1
For i = 0 To 512
  levels(i) = -104 + 3 * Rnd + 46 / (1 + ((i - 200) / 4) ^ 2)
Next
hub.Publish SpectrumPath, levels

panel.addMarker
panel.markerToMax
panel.SavePicture WScript.Arguments(0)
WScript.Echo "picture written: " & WScript.Arguments(0)
