' The spectrum panel. Its last line says that the script came to its end.
Const SpectrumPath = "Brantor Scanner/Spectrum/Spectrum Trace"
Dim panel, buffer, length

Sub Statuses()
  Check "resource id is taken", panel.vfpSet(0, 315, 0, 7), 0
  Check "other text is an unusable parameter", panel.vfpSet(0, 312, 0, "abc"), -8
  Check "and is reported word for word", LastMessage(), "clsBaseVFP::vfpSet() PARM_MEASUREMENT_ID must be numeric|"
  Check "caption is applied", panel.vfpSet(0, 314, 0, "Receiver 1"), 0
  Check "and read back", panel.Caption, "Receiver 1"
  Check "showing works without a parameter", panel.vfpOp(0, 12), 0
  Check "an unknown operation answers -1", panel.vfpOp(0, 99, 1), -1
  Check "operation 10 with 10 adds the trace", panel.vfpOp(0, 10, 10), 0
End Sub

Sub Errors()
  On Error Resume Next
  panel.noSuchMember
  Check "an unknown member is error 438", Err.Number, 438
  Err.Clear
  panel.vfpOp 0, 70000, 1
  Check "a value too large for its width is error 6", Err.Number, 6
  Err.Clear
  hub.Value "no such path", 0
  Check "an item that is not there is error 9", Err.Number, 9
  Check "and explains itself", Err.Description, "Subscript out of range"
  Err.Clear
  panel.SavePicture "Z:\no such folder\x.png"
  CheckDrawn "a picture nowhere is an error", Err.Number, 75
  CheckDrawn "that says why", Err.Description, "Path/File access error"
  Err.Clear
End Sub

Sub Sweep()
  Dim levels(512), i, files
  For i = 0 To 512
    levels(i) = -90 + 50 / (1 + (i - 200) * (i - 200) / 16)
  Next
  Check "centre is taken", panel.vfpSet(0, 13, 0, 98000000), 0
  Check "span is taken", panel.vfpSet(0, 14, 0, "20000000"), 0
  hub.Publish SpectrumPath, levels
  Check "the hub holds the sweep", hub.ItemCount(SpectrumPath), 513
  Check "and its items", hub.Value(SpectrumPath, 200), -40
  panel.addMarker
  panel.markerToMax
  If draws Then panel.SavePicture folder & "\late_bound.png"
  Set files = CreateObject("Scripting.FileSystemObject")
  CheckDrawn "the picture is written", files.FileExists(folder & "\late_bound.png"), True
  CheckDrawn "nothing else was reported", diagnostics.Count, 1
End Sub

Function ResultsOf(resource, carrierAt)
  Dim levels(512), i
  For i = 0 To 512
    levels(i) = -100
  Next
  levels(carrierAt) = -25
  Set buffer = CreateObject("FrontPanels.ResultBuffer")
  buffer.HardwareId resource
  buffer.BeginMeasurement 12
  buffer.BeginSubMeasurement 1
  buffer.BeginRecord 25
  buffer.Float32Array levels
  buffer.EndRecord
  buffer.BeginRecord 4711
  buffer.Int16 1
  buffer.EndRecord
  buffer.EndSubMeasurement
  buffer.EndMeasurement
  length = buffer.Length
  ResultsOf = buffer.Bytes
End Function

Function Listed(list)
  Dim i
  For i = 0 To UBound(list)
    Listed = Listed & " " & list(i)
  Next
End Function

Sub Results()
  Dim other, bytes, cursor, bytesLeft, list, i, again
  Set other = CreateObject("FrontPanels.SpectrumView")
  Check "the measurement is taken", other.vfpSet(0, 312, 0, 12), 0
  diagnostics.Clear
  bytes = ResultsOf(5, 100)
  bytesLeft = length
  cursor = 0
  Check "a buffer for any resource is shown while none is set", other.displayData(Empty, bytes, cursor, bytesLeft, 0, 0), 0
  Check "the cursor stands at the end", cursor, length
  Check "with nothing left", bytesLeft, 0
  CheckDrawn "a record that the panel does not know is stepped over", diagnostics.Count, 1
  Check "with a report", LastMessage(), "SpectrumView::DisplayData() ... no data read for result type 4711|"
  other.vfpOp 0, 10, 10
  other.addMarker
  other.markerToMax
  CheckDrawn "the report holds the marker's reading", InStr(other.reportHtml, "<td>1</td>") > 0, True
  CheckDrawn "and the picture", InStr(other.reportHtml, "src=""data:image/png;base64,iVBORw0KGgo") > 0, True

  cursor = 3
  Check "a cursor that lies about the count is refused", other.displayData(Empty, bytes, cursor, length, 0, 0), -8
  Check "and stays", cursor, 3
  Check "numbers may stand for bytes", other.displayData(Empty, Array(5, 0, 0, 0, 0, 0, 0, 0), 0, 8, 0, 0), 0
  Check "but 256 is none", other.displayData(Empty, Array(256, 0, 0, 0, 0, 0, 0, 0), 0, 8, 0, 0), -8

  list = other.Settings
  Set again = CreateObject("FrontPanels.SpectrumView")
  again.vfpOp 0, 10, 10
  For i = 0 To UBound(list) Step 2
    If again.vfpSet(0, list(i), 0, list(i + 1)) <> 0 Then Check "setting " & list(i) & " is taken", False, True
  Next
  Check "what was handed over restores another panel", Listed(again.Settings), Listed(list)
  other.baseInstance.warnOnUnhandledParameters = True
  other.vfpSet 0, 4000, 0, 1
  Check "the base is reached by name", LastMessage(), "SpectrumView::vfpSet() ... unhandled parameterType = 4000|"
  Check "and read", other.baseInstance.measurementId, 12
  diagnostics.Clear
End Sub

Sub Channels()
  Dim tuned, center
  Set tuned = CreateObject("FrontPanels.SpectrumView")
  Set center = tuned.Constituent("CenterFrequencyTextBox")
  Check "bands are taken", tuned.Limits(13, Array(0, 869040000, 893970000, 1, 824040000, 848970000)), 0
  Check "limits of what has no entry are refused", tuned.Limits(99, Array(0, 1, 2)), -8
  tuned.ChannelZero 0, 870000000
  tuned.ChannelZero 1, 825000000
  tuned.ChannelSpacing 0, 30000
  tuned.ChannelSpacing 1, 30000
  tuned.ChannelLookup 0, 0, 1
  tuned.vfpSet 0, 333, 0, 0
  tuned.vfpSet 0, 14, 0, 2000000
  tuned.vfpSet 0, 13, 0, 836520000
  Check "a centre chooses its band", tuned.Constituent("UplinkOption").Value, True
  tuned.vfpSet 0, 750, 0, 0
  Check "and reads as a channel", center.Text, "384"
  tuned.Constituent("DownlinkOption").Click
  Check "which the other band has, too", center.Text & " " & tuned.initializeLinkValue(3, 13), "384 881520000"
  hub.Publish SpectrumPath, Array(-60, -20, -60)
  tuned.addMarker
  tuned.markerToMax
  tuned.addDeltaMarker
  Check "one delta marker is enough", tuned.Constituent("MarkerDeltaButton").Enabled, False
  tuned.deleteMarker
  Check "nothing is left to delete", tuned.Constituent("MarkerDeleteButton").Enabled, False
  Check "an area answers", tuned.displayPanel.Visible, True
End Sub

Sub CellNames()
  Dim names, i
  Set names = CreateObject("FrontPanels.clsCellNameInfo")
  Check "no cell has a name", names.GetCellName(5, -1), "Unknown"
  names.SetCellName 5, 7, "Town Hall"
  names.SetCellName 5, 7, "Station"
  Check "a cell is found by one identifier", names.GetCellName(5, -1), "Town Hall"
  Check "by both", names.GetCellName("5", 7.0), "Town Hall"
  Check "not by another", names.GetCellName(5, 0), "Unknown"
  Check "the longest name counts", names.maxCellNameLength, 9
  names.maxCellNameLength = 20
  Check "or what was set", names.maxCellNameLength, 20
  names.SetCellName 6, 0, String(32768, "x")
  Check "a name that is too long is reported", LastMessage(), "clsCellNameInfo::SetCellName()|Overflow"
  diagnostics.Clear
  For i = 1 To 32766
    names.SetCellName i, 1, "Cell " & i
  Next
  Check "the last of many is refused", diagnostics.Count & names.GetCellName(32766, 1), "1Unknown"
  Check "the one before it found", names.GetCellName(32765, 1), "Cell 32765"
  names.Initialize
  Check "all are forgotten", names.GetCellName(5, -1) & names.maxCellNameLength, "Unknown0"
  diagnostics.Clear
End Sub

Sub Closing()
  Check "closing answers 0", panel.vfpOp(0, 1), 0
  Check "then everything does", panel.vfpSet(0, 312, 0, "abc"), 0
  diagnostics.Clear
  Check "and nothing is reported", diagnostics.Count, 0
  hub.Publish SpectrumPath, -50
  Check "a sweep after the close is ignored", diagnostics.Count, 0
End Sub

Set panel = CreateObject("FrontPanels.SpectrumView")
Check "messages can be kept without boxes", diagnostics.ShowMessages, False
Statuses
Errors
Sweep
Results
Channels
CellNames
Closing
Set panel = Nothing
WScript.Echo "script finished"
