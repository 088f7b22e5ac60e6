#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnTextFile.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

namespace {

KM_wString Heading(const KM_wString& name) {
    return KM_wString(L"<HTML>\n <HEAD>\n  <TITLE>") + name +
           L"</TITLE>\n </HEAD>\n <BODY onLoad=\"Load()\">\n <FONT FACE=VERDANA SIZE=2><B>" + name;
}

KM_wString PictureAndButtons() {
    KM_wString page = L"</B><BR>\n"
                      L"\t<IMG BORDER=1 STYLE=\"border-color:black\" ID=\"animated_image\"><BR>\n"
                      L"<FONT FACE=COURIER SIZE=2>\n"
                      L"<SPAN ID=\"frame_title\" STYLE=\"position:relative;left:0;top:-15;"
                      L"color:black;background-color:white;padding:1px;border-width:1px;"
                      L"border-style:solid;border-color:black;display:inline;\"></SPAN>\n"
                      L"&nbsp;</FONT><BR>\n"
                      L"  <BUTTON ID=\"btnToggle\" onClick=\"start_stop()\" "
                      L"onDblClick=\"start_stop()\">";
    page += QnLocalizeString(L"Stop", 15604);
    page += L"</BUTTON>&nbsp;\n"
            L"<BUTTON ID=\"btnFirst\" onClick=\"firstFrame()\" onDblClick=\"firstFrame()\" "
            L"STYLE=\"width:35\">&lt;&lt;</BUTTON>&nbsp;\n"
            L"  <BUTTON ID=\"btnPrev\" onClick=\"prevFrame()\" onDblClick=\"prevFrame()\" "
            L"STYLE=\"width:35\">&lt;</BUTTON>&nbsp;\n"
            L"  <BUTTON ID=\"btnNext\" onClick=\"nextFrame()\" onDblClick=\"nextFrame()\" "
            L"STYLE=\"width:35\">&gt;</BUTTON>&nbsp;\n"
            L"  <BUTTON ID=\"btnLast\" onClick=\"lastFrame()\" onDblClick=\"lastFrame()\" "
            L"STYLE=\"width:35\">&gt;&gt;</BUTTON>\n";
    return page;
}

KM_wString LoopAndCounterBoxes() {
    // The second quote behind the loop box's ID is part of the page's text. Browsers pass over it.
    KM_wString page = L"  <FONT SIZE=1>\n"
                      L"  <BR><BR>&nbsp;&nbsp;&nbsp;<INPUT ID=\"checkLoop\""
                      L"\" TYPE=\"checkbox\" style=\"width:13;height:13;\">";
    page += QnLocalizeString(L"Loop continuously", 15605);
    page += L"\n  <BR>&nbsp;&nbsp;&nbsp;<INPUT ID=\"checkCounter\" TYPE=\"checkbox\" CHECKED "
            L"onClick=\"showCounter(this.checked)\" style=\"width:13;height:13;\">";
    page += QnLocalizeString(L"Show frame counter", 15606);
    return page;
}

KM_wString Footer() {
    KM_wString page = L"\n  </FONT>\n  <P>\n  <FONT COLOR=888888 SIZE=1>";
    page += QnLocalizeString(L"Animation created in", 15607);
    page += L" <A HREF=\"https://quarn.example/\" TARGET=_blank>"
            L"<FONT COLOR=7777ff SIZE=1>Quarn</FONT></A>"
            L".</FONT>\n </BODY>\n</HTML>\n\n";
    return page;
}

/// The style, and the script's variables: the images and their labels.
KM_wString StyleAndImages(KM_3dmAnimationProperties& props) {
    const KM_ClassArray<KM_wString>& images = props.Images();
    const KM_ClassArray<KM_wString>& dates = props.Dates();
    KM_wString page = L"<STYLE>\n"
                      L"  button {width:75;height:25;font-family:mssansserif;font-size:8pt}\n"
                      L"</STYLE>\n"
                      L"<SCRIPT LANGUAGE=\"JavaScript\">\n"
                      L"  var FRAME_DELAY = 75;\n"
                      L"  var timeoutID;\n"
                      L"  var ImageCount = ";
    page += KM_wString::FormatToString(L"%d", images.Count());
    page += L";\n"
            L"  var Images = new Array();\n"
            L"  for( i=0; i < ImageCount; i++ )\n"
            L"  \tImages[i] = new Image();\n\n"
            L"  var currentImageIndex = 0;\n"
            L"  bDisplayDate = ";
    page += KM_wString::FormatToString(L"%d;\n\n", props.IsSunStudy() ? 1 : 0);
    page += KM_wString::FormatToString(L"  var Dates = new Array(%d);\n", dates.Count());
    for (int i = 0; i < images.Count(); ++i)
        page += KM_wString::FormatToString(L"Images[%d].src = \"", i) + images[i] + L"\"\n";
    for (int i = 0; i < dates.Count(); ++i)
        page += KM_wString::FormatToString(L"Dates[%d] = \"", i) + dates[i] + L"\"\n";
    return page;
}

constexpr const wchar_t* playing_functions = LR"js(  var bRunning = false;

  function Load()
  {
    begin_animation();
  }

  function begin_animation()
  {
    stop_animation();
    EnableCtrls("stop");
    run();
    bRunning = true;
  }

  function stop_animation()
  {
    EnableCtrls("start");
    clearTimeout(timeoutID);
    bRunning = false;
  }

  function start_stop()
  {
    if( bRunning )
      stop_animation();
    else
      begin_animation();
  }

  function run()
  {
    if( nextFrame() )
      timeoutID = setTimeout("run()", FRAME_DELAY);
  }

)js";

constexpr const wchar_t* stepping_functions = LR"js(  function firstFrame()
  {
    if( ImageCount < 1 )
      return;
    currentImageIndex = 0;
    document.getElementById("animated_image").src = Images[currentImageIndex].src;
    DisplayCaption(currentImageIndex);
  }

  function prevFrame()
  {
    if( ImageCount < 1 )
      return;
    currentImageIndex--;
    if( currentImageIndex < 0 )
      currentImageIndex = ImageCount - 1;
    document.getElementById("animated_image").src = Images[currentImageIndex].src;
    DisplayCaption(currentImageIndex);
  }

  function nextFrame()
  {
    currentImageIndex++;
    if( currentImageIndex >= ImageCount )
    {
      currentImageIndex = 0;
      if( ImageCount < 1 || !document.getElementById("checkLoop").checked )
      {
        stop_animation();
        return false;
      }
    }
    document.getElementById("animated_image").src = Images[currentImageIndex].src;
    DisplayCaption(currentImageIndex);
    return true;
  }

  function lastFrame()
  {
    if( ImageCount < 1 )
      return;
    currentImageIndex = ImageCount - 1;
    document.getElementById("animated_image").src = Images[currentImageIndex].src;
    DisplayCaption(currentImageIndex);
  }

  function DisplayCaption(nFrameNumber)
  {
    document.getElementById("frame_title").textContent =
      bDisplayDate ? Dates[nFrameNumber] : nFrameNumber + 1;
  }

)js";

/// The functions that change the controls. They name no button that the page does not have but in
/// comments, which pages carry for those who put separate buttons in.
KM_wString ControlFunctions() {
    KM_wString script = L"  function EnableCtrls(sCtl)\n"
                        L"  {\n"
                        L"    var bStopped = ( sCtl == \"start\" );\n"
                        L"    document.getElementById(\"btnFirst\").disabled = !bStopped;\n"
                        L"    document.getElementById(\"btnPrev\").disabled = !bStopped;\n"
                        L"    document.getElementById(\"btnNext\").disabled = !bStopped;\n"
                        L"    document.getElementById(\"btnLast\").disabled = !bStopped;\n"
                        L"    if( sCtl == \"stop\" )\n"
                        L"    {\n"
                        L"      //document.getElementById(\"btnStop\").disabled = false;\n"
                        L"      //document.getElementById(\"btnStart\").disabled = true;\n"
                        L"      document.getElementById(\"btnToggle\").textContent = \"";
    script += QnLocalizeString(L"Stop", 15620);
    script += L"\";\n"
              L"    }\n"
              L"    else if( sCtl == \"start\" )\n"
              L"    {\n"
              L"      //document.getElementById(\"btnStop\").disabled = true;\n"
              L"      //document.getElementById(\"btnStart\").disabled = false;\n"
              L"      document.getElementById(\"btnToggle\").textContent = \"";
    script += QnLocalizeString(L"Start", 15621);
    script += L"\";\n"
              L"    }\n"
              L"  }\n\n"
              L"  function showCounter(bShow)\n"
              L"  {\n"
              L"    document.getElementById(\"frame_title\").style.display = "
              L"bShow ? \"inline\" : \"none\";\n"
              L"  }\n";
    return script;
}

} // namespace

KM_wString CZoetrixUtilities::GetHTMLtemplate(KM_3dmAnimationProperties& props) {
    KM_wString page = Heading(props.HtmlFilename());
    page += PictureAndButtons();
    page += LoopAndCounterBoxes();
    page += Footer();
    page += StyleAndImages(props);
    page += playing_functions;
    page += stepping_functions;
    page += ControlFunctions();
    page += L"</SCRIPT>\n";
    return page;
}

bool WriteHTML(KM_3dmAnimationProperties& props, const wchar_t* path) {
    const KM_wString page = CZoetrixUtilities::GetHTMLtemplate(props);
    KM_wString trimmed_path = path;
    trimmed_path.TrimLeftAndRight();
    if (trimmed_path.IsEmpty())
        return false;

    CQnTextFile file;
    if (!file.Open(trimmed_path, CQnTextFile::open_mode::write, CQnTextFile::filetype::utf8_bom))
        return false;
    return file.WriteString(page) && file.Close();
}
