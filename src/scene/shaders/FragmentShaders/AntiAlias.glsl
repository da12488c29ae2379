// The picture, each pixel the mean of four places within it.
uniform vec2 u_FrameSize;
uniform sampler2D t_Buffer;

vec4 At(vec2 i_Offset)
{
	return texture2D(t_Buffer, (gl_FragCoord.xy + i_Offset) / u_FrameSize);
}

void main()
{
	gl_FragColor = 0.25 * (At(vec2(-0.25, -0.25)) + At(vec2(0.25, -0.25)) + At(vec2(-0.25, 0.25)) + At(vec2(0.25, 0.25)));
}
