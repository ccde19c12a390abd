VERSION 5.00
Object = "{A2BAE000-2A21-452D-A7B2-E32C4B34DEB5}#1.0#0"; "frontpanels.ocx"
Begin VB.Form SpectrumForm
   Caption         =   "A receiver"
   ClientHeight    =   9600
   ClientLeft      =   60
   ClientTop       =   345
   ClientWidth     =   13200
   LinkTopic       =   "SpectrumForm"
   ScaleHeight     =   9600
   ScaleWidth      =   13200
   StartUpPosition =   2  'CenterScreen
   Begin VB.Timer Sweeps
      Interval        =   100
      Left            =   120
      Top             =   120
   End
   Begin FrontPanels.SpectrumView Panel
      Height          =   9600
      Left            =   0
      TabIndex        =   0
      Top             =   0
      Width           =   13200
   End
End
Attribute VB_Name = "SpectrumForm"
Attribute VB_GlobalNameSpace = False
Attribute VB_Creatable = False
Attribute VB_PredeclaredId = True
Attribute VB_Exposed = False
' A form with a panel: it is told what the receiver has, and asks for what the user wants.
' Start: regsvr32 frontpanels.ocx (the 32-bit one), open this file in a Standard EXE project, make it the
' startup form and run it. Written by hand and not run by the project's tests, which have no Visual Basic.
Option Explicit
Private Const SpectrumPath As String = "Brantor Scanner/Spectrum/Spectrum Trace"
Private Const CodeCenter As Integer = 13
Private Const CodeSpan As Integer = 14
Private Const OpClose As Integer = 1

Private Hub As FrontPanels.DataHub
Private CenterHz As Double
Private SpanHz As Double
Private Closing As Boolean

Private Sub Form_Load()
    Set Hub = New FrontPanels.DataHub
    CenterHz = 881520000#
    SpanHz = 5000000#
    Panel.vfpSet 0, 314, 0, "Receiver 1"
    Tell CodeCenter, CenterHz
    Tell CodeSpan, SpanHz
    Panel.vfpOp 0, 12, 0
End Sub

Private Sub Form_Resize()
    If WindowState <> vbMinimized Then Panel.Move 0, 0, ScaleWidth, ScaleHeight
End Sub

Private Sub Sweeps_Timer()
    Dim Levels(0 To 512) As Single
    Dim I As Long
    Dim Offset As Double
    If Closing Then Unload Me: Exit Sub
    For I = 0 To 512
        Offset = (CenterHz + SpanHz * (I / 512 - 0.5) - 881520000#) / 60000#
        Levels(I) = -105 + 2 * Rnd
        If Abs(Offset) < 5 Then Levels(I) = Levels(I) + 50 * Exp(-Offset * Offset)
    Next
    Hub.Publish SpectrumPath, Levels
End Sub

' The user's wish. The status says whether it is taken; the value comes back through vfpSet.
Private Sub Panel_frontPanelSet(ByVal hwId As Long, ByVal vfpId As Long, ByVal parameterType As Integer, ByVal index As Integer, ByVal newValue As Variant, status As Long)
    status = 0
    Select Case parameterType
        Case CodeCenter: CenterHz = newValue: Tell CodeCenter, CenterHz
        Case CodeSpan: SpanHz = newValue: Tell CodeSpan, SpanHz
    End Select
End Sub

' Visual Basic does not unload a form inside every event: the timer does it.
Private Sub Panel_frontPanelOp(ByVal hwId As Long, ByVal vfpId As Long, ByVal OP As Integer, ByVal argument As Variant, status As Long)
    status = 0
    If OP = OpClose Then Closing = True
End Sub

Private Sub Tell(ByVal Code As Integer, ByVal Hz As Double)
    Panel.vfpSet 0, Code, 0, Hz
End Sub
