// Fill and edge of what is selected or preselected, from the frame of ids alone: the flags are bits of blue.
const float c_Opacity = 0.75;
// Half a byte below each value, since bytes come back as fractions that are not exact.
const float c_HalfByte = 0.5 / 255.0;
const float c_Primary = 99.5 / 255.0;
const float c_Preselected = 63.5 / 255.0;
const vec3 c_SelectedColour = vec3(0.25);

uniform vec2 u_FrameSize;
uniform sampler2D t_Selection;
uniform vec4 u_PrimaryColour;
uniform vec3 u_PreSelectColour;

vec4 IdAt(vec2 i_Offset)
{
	return texture2D(t_Selection, (gl_FragCoord.xy + i_Offset) / u_FrameSize);
}

float Differs(vec4 i_A, vec4 i_B)
{
	vec3 difference = abs(i_A.rgb - i_B.rgb);
	return step(c_HalfByte, max(max(difference.r, difference.g), difference.b));
}

void main()
{
	vec4 centre = IdAt(vec2(0.0));
	vec4 a = IdAt(vec2(-0.9, -0.9));
	vec4 b = IdAt(vec2(0.9, -0.9));
	vec4 c = IdAt(vec2(-0.9, 0.9));
	vec4 d = IdAt(vec2(0.9, 0.9));
	float Diff = min(1.0, Differs(a, centre) + Differs(b, centre) + Differs(c, centre) + Differs(d, centre));
	float Intensity = Diff * c_Opacity;
	bool touchingPrimary = max(max(max(a.b, b.b), max(c.b, d.b)), centre.b) >= c_Primary;

	if (touchingPrimary)
	{
		// One diagonal of four: the sum is whole, so that two of them come to 0.5 or above.
		float hatching = fract(0.25 * (gl_FragCoord.x + gl_FragCoord.y)) > 0.5 ? 1.0 : 0.0;
		gl_FragColor = vec4(u_PrimaryColour.rgb * (hatching + Intensity), Intensity);
		return;
	}
	vec3 fill = vec3(0.0);
	if (centre.b >= c_Preselected)
		fill = u_PreSelectColour;
	else if (centre.b >= c_HalfByte)
		fill = c_SelectedColour;
	gl_FragColor = vec4(fill + Intensity, 0.0);
}
